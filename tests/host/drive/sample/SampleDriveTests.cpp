// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "host/drive/sample/SampleDrive.h"
#include "host/drive/service/LocalCloudDocumentService.h"
#include "platform/TypeRegistry.h"
#include "tests/support/DriveFixture.h"

#include <nlohmann/json.hpp>

#include <sys/stat.h>
#include <unistd.h>

#include <map>
#include <set>

namespace {

using host::drive::DriveLayout;
using namespace platform;
using testing::UnorderedElementsAreArray;
using testing_support::DriveFixture;
namespace fs = std::filesystem;

/// All tests share one sample drive, because making it takes a moment.
class SampleDriveTests : public testing::Test {
protected:
    static void SetUpTestSuite()
    {
        _drive = std::make_unique<DriveFixture>();
        _layout = std::make_unique<DriveLayout>(DriveLayout::at(_drive->folder().at("sample")));
        _first = host::drive::sample::makeSampleDrive(*_layout);
        _cloud = host::drive::LocalCloudDocumentService::create(*_layout,
            {_drive->dispatch, _drive->notifications, _drive->installed.typeRegistry, nullptr, nullptr},
            {{"de"}, _drive->folder().at("t")});
    }
    static void TearDownTestSuite()
    {
        fs::permissions(_layout->documents() + '/' + host::drive::sample::lockedFolder, fs::perms::owner_all);
        _cloud.reset();
        _layout.reset();
        _drive.reset();
    }

    /// Answers every item below the documents area by its logical path; a promise stands for its item.
    static std::vector<Url> items()
    {
        std::vector<Url> found;
        constexpr auto options = fs::directory_options::skip_permission_denied;
        for (const auto& entry : fs::recursive_directory_iterator(_layout->documents(), options)) {
            const auto url = Url::fileURL(entry.path().string());
            found.push_back(_cloud->promisedItems().logicalURLForPromise(url));
        }
        return found;
    }
    static platform::AttributeMap values(const Url& url)
    {
        constexpr AttributeKey keys[] = {AttributeKey::TypeIdentifier, AttributeKey::DownloadingStatus,
            AttributeKey::IsPackage, AttributeKey::IsShared, AttributeKey::SharedItemRole,
            AttributeKey::FileSize};
        const auto result = _cloud->promisedItems().promisedItemResourceValues(url, keys);
        EXPECT_TRUE(result) << url.path();
        return result.value.value_or(platform::AttributeMap());
    }
    static std::map<std::string, std::string> contents()
    {
        std::map<std::string, std::string> found;
        constexpr auto options = fs::directory_options::skip_permission_denied;
        for (const auto& entry : fs::recursive_directory_iterator(_layout->home(), options)) {
            struct stat status { };
            ::lstat(entry.path().c_str(), &status);
            std::ifstream file(entry.path(), std::ios::binary);
            found[entry.path().string()] = std::to_string(status.st_ino) + ' '
                + std::to_string(status.st_mtim.tv_nsec) + ' '
                + (entry.is_regular_file() ? std::string(std::istreambuf_iterator<char>(file), {}) : "");
        }
        return found;
    }

    static inline std::unique_ptr<DriveFixture> _drive;
    static inline std::unique_ptr<DriveLayout> _layout;
    static inline host::drive::sample::Outcome _first;
    static inline std::shared_ptr<host::drive::LocalCloudDocumentService> _cloud;
};

TEST_F(SampleDriveTests, holdsEveryKindOfItem)
{
    ASSERT_FALSE(_first.error);
    std::set<std::string> kinds, tags;
    int promises = 0, packages = 0, owned = 0, joined = 0, references = 0, linksOut = 0, linksIn = 0;
    for (const auto& url : items()) {
        const auto found = values(url);
        const auto type = *found.optional<std::string>(AttributeKey::TypeIdentifier);
        for (const char* kind : {"public.text", "public.source-code", "public.png", "public.jpeg",
                 "public.svg-image", "public.pdf", "public.audio", "public.movie"}) {
            if (platform::services().typeRegistry().conformsTo(type, kind))
                kinds.insert(kind);
        }
        promises += found.optional<platform::DownloadingStatus>(AttributeKey::DownloadingStatus)
            == platform::DownloadingStatus::NotDownloaded;
        packages += found.flag(AttributeKey::IsPackage);
        owned += found.optional<platform::SharedItemRole>(AttributeKey::SharedItemRole)
            == platform::SharedItemRole::Owner;
        joined += found.optional<platform::SharedItemRole>(AttributeKey::SharedItemRole)
            == platform::SharedItemRole::Participant;
        references += _cloud->promisedItems().isExternalDocumentReference(url);
        if (type == platform::typeIdentifier::symlink)
            ++(_cloud->items().isInDocumentsArea(_cloud->items().realURL(url)) ? linksIn : linksOut);
        const auto names = _cloud->promisedItems().readItem(url, {}).tagNames;
        tags.insert(names.begin(), names.end());
    }
    EXPECT_EQ(kinds.size(), 8u) << testing::PrintToString(kinds);
    EXPECT_GE(promises, 5);
    EXPECT_GE(packages, 1);
    EXPECT_GE(owned, 1);
    EXPECT_GE(joined, 1);
    EXPECT_GE(references, 1);
    EXPECT_EQ(linksIn, 1);
    EXPECT_EQ(linksOut, 1);

    // The shared table contains every tag in use, and all eight colours are in use.
    std::ifstream file(_layout->keyValueStore());
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

TEST_F(SampleDriveTests, whatIsPromisedLiesInTheCloudAndReferencesAndAliasesLeadSomewhere)
{
    std::uintmax_t promised = 0, stored = 0;
    for (const auto& url : items()) {
        auto& promisedItems = _cloud->promisedItems();
        const auto found = values(url);
        if (!promisedItems.physicalURLForPromise(url).isSameObject(url))
            promised += found.optional<std::uint64_t>(AttributeKey::FileSize).value_or(0);
        if (promisedItems.isExternalDocumentReference(url)) {
            EXPECT_FALSE(promisedItems.checkPromisedItemIsReachable(
                *promisedItems.resolveExternalDocumentReference(url)));
        }
        if (url.pathExtension() == "trwalias") {
            EXPECT_TRUE(promisedItems.resolveAliasFile(url)) << url.path();
        }
    }
    for (const auto& entry : fs::directory_iterator(_layout->cloud()))
        stored += entry.file_size();
    EXPECT_GT(promised, 0u);
    EXPECT_EQ(promised, stored);
}

TEST_F(SampleDriveTests, librariesFoldersAndAnOwner)
{
    const auto containers = _cloud->containers().allContainers();
    ASSERT_GE(containers.size(), 3u);
    EXPECT_EQ(containers[0]->identifier, DriveLayout::defaultContainerIdentifier);
    for (std::size_t i = 1; i < containers.size(); ++i) {
        EXPECT_FALSE(containers[i]->owningApps.empty());
        EXPECT_TRUE(containers[i]->documentsURL);
    }
    EXPECT_EQ(
        _cloud->containers().containerWithIdentifier("app.tarrow.Sketchbook")->localizedName, "Skizzenbuch");
    const auto large = fs::directory_iterator(_layout->documents() + '/' + host::drive::sample::largeFolder);
    EXPECT_EQ(std::distance(large, fs::directory_iterator()), host::drive::sample::largeFolderCount);
    struct stat status { };
    ASSERT_EQ(::stat((_layout->documents() + '/' + host::drive::sample::lockedFolder).c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0u);
    EXPECT_TRUE(_cloud->account().identityToken());
}

TEST_F(SampleDriveTests, makingItAgainChangesNothing)
{
    const auto before = contents();
    const auto again = host::drive::sample::makeSampleDrive(*_layout);
    EXPECT_FALSE(again.error);
    EXPECT_EQ(again.written, 0);
    EXPECT_EQ(contents(), before);
}

TEST_F(SampleDriveTests, whatIsThereIsKeptAndWhatIsMissingIsAdded)
{
    const auto layout = DriveLayout::at(_drive->folder().at("other"));
    const auto mine = _drive->folder().write("other/documents/BrindleDefault/Desktop/To do.txt", "mine");
    _drive->folder().write("other/account.json", R"({"identity": "me"})");
    const auto outcome = host::drive::sample::makeSampleDrive(layout);
    EXPECT_FALSE(outcome.error);
    EXPECT_EQ(outcome.written, _first.written - 2);
    EXPECT_EQ(fs::file_size(mine), 4u);
    EXPECT_EQ(host::drive::AccountRecord::read(layout)->identity, "me");
    fs::permissions(layout.documents() + '/' + host::drive::sample::lockedFolder, fs::perms::owner_all);
}

TEST_F(SampleDriveTests, aFailureIsToldAndEndsTheWork)
{
    _drive->folder().write("blocked/documents", "no folder");
    const auto outcome =
        host::drive::sample::makeSampleDrive(DriveLayout::at(_drive->folder().at("blocked")));
    EXPECT_TRUE(outcome.error);
    EXPECT_FALSE(fs::exists(_drive->folder().at("blocked/account.json")))
        << "nobody is signed in to half a drive";
}

} // namespace
