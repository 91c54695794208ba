// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "host/drive/sample/SampleDrive.h"
#include "platform/TypeRegistry.h"
#include "tests/support/DriveFixture.h"

#include <nlohmann/json.hpp>

#include <set>

namespace {

namespace fs = std::filesystem;

using namespace platform;
using namespace testing;
using host::drive::sample::makeSampleDrive;

class SampleDriveTests : public Test, public testing_support::DriveFixture {
protected:
    ~SampleDriveTests() override
    {
        std::error_code isMissing;
        fs::permissions(
            layout().documents() + '/' + host::drive::sample::lockedFolder, fs::perms::owner_all, isMissing);
    }
};

TEST_F(SampleDriveTests, addsEveryKindOfItemToWhatIsThere)
{
    const auto mine = writeDocument("Desktop/To do.txt", "mine");
    const auto first = makeSampleDrive(layout());
    ASSERT_FALSE(first.error);
    EXPECT_GT(first.written, host::drive::sample::largeFolderCount);
    EXPECT_EQ(makeSampleDrive(layout()).written, 0);
    EXPECT_EQ(testing_support::contentOf(mine), "mine");
    EXPECT_EQ(host::drive::AccountRecord::read(layout())->identity, "account-1");
    EXPECT_GE(cloud->containers().allContainers().size(), 3U);

    std::set<std::string> kinds, tags;
    std::uintmax_t promised = 0, stored = 0;
    auto& promisedItems = cloud->promisedItems();
    constexpr auto options = fs::directory_options::skip_permission_denied;
    for (const auto& entry : fs::recursive_directory_iterator(layout().documents(), options)) {
        const auto url = promisedItems.logicalURLForPromise(Url::fileURL(entry.path().string()));
        constexpr AttributeKey keys[] = {AttributeKey::TypeIdentifier, AttributeKey::IsPackage,
            AttributeKey::SharedItemRole, AttributeKey::FileSize};
        const auto reading = promisedItems.readItem(url, keys);
        ASSERT_TRUE(reading.values) << url.path();
        const auto type = *reading.values->optional<std::string>(AttributeKey::TypeIdentifier);
        const auto role = reading.values->optional<SharedItemRole>(AttributeKey::SharedItemRole);
        const bool isInside = cloud->items().isInDocumentsArea(cloud->items().realURL(url));
        const bool isPromised = !reading.physicalURL.isSameObject(url);
        const auto note = [&](bool isOne, const char* kind) {
            if (isOne)
                kinds.insert(kind);
        };
        for (const char* kind : {"public.text", "public.source-code", "public.png", "public.jpeg",
                 "public.svg-image", "public.pdf", "public.audio", "public.movie"})
            note(services().typeRegistry().conformsTo(type, kind), kind);
        note(isPromised, "promise");
        note(reading.values->flag(AttributeKey::IsPackage), "package");
        note(role == SharedItemRole::Owner, "owned");
        note(role == SharedItemRole::Participant, "joined");
        note(promisedItems.resolveExternalDocumentReference(url).value.has_value(), "reference");
        note(promisedItems.resolveAliasFile(url).value.has_value(), "alias");
        note(type == typeIdentifier::symlink, isInside ? "link inside" : "link outside");
        tags.insert(reading.tagNames.begin(), reading.tagNames.end());
        if (isPromised)
            promised += reading.values->optional<std::uint64_t>(AttributeKey::FileSize).value_or(0);
    }
    EXPECT_EQ(kinds.size(), 16U) << PrintToString(kinds);
    for (const auto& entry : fs::directory_iterator(layout().cloud()))
        stored += entry.file_size();
    EXPECT_EQ(promised, stored) << "what is promised lies in the cloud";

    // The shared table contains every tag in use, and all eight colours are in use.
    std::ifstream file(layout().keyValueStore());
    const auto table = nlohmann::json::parse(file, nullptr, false);
    ASSERT_EQ(table["PathwellTagDict"]["PathwellTagDictVersion"], 2);
    std::set<std::string> known;
    std::set<int> colours;
    for (const auto& entry : table["PathwellTagDict"]["PathwellTags"]) {
        known.insert(entry["n"].get<std::string>());
        colours.insert(entry["l"].get<int>());
    }
    EXPECT_THAT(known, UnorderedElementsAreArray(tags));
    EXPECT_EQ(colours, (std::set<int>{0, 1, 2, 3, 4, 5, 6, 7}));
}

TEST_F(SampleDriveTests, aFailureIsToldAndEndsTheWork)
{
    folder().write("blocked/documents", "no folder");
    const auto blocked = host::drive::DriveLayout::at(folder().at("blocked"));
    EXPECT_TRUE(makeSampleDrive(blocked).error);
    EXPECT_FALSE(fs::exists(blocked.account())) << "nobody is signed in to half a drive";
}

} // namespace
