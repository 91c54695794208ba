// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/PromiseRecord.h"
#include "platform/FileCoordinator.h"
#include "tests/support/DriveFixture.h"

#include <sys/stat.h>

namespace {

using host::drive::PromiseRecord;
using namespace platform;
using namespace testing;
using testing_support::DriveFixture;

constexpr AttributeKey allKeys[] = {AttributeKey::Name, AttributeKey::LocalizedName,
    AttributeKey::TypeIdentifier, AttributeKey::LocalizedTypeDescription, AttributeKey::FileSize,
    AttributeKey::CreationDate, AttributeKey::ContentModificationDate, AttributeKey::IsDirectory,
    AttributeKey::IsPackage, AttributeKey::HasHiddenExtension, AttributeKey::ParentDirectoryURL,
    AttributeKey::IsShared, AttributeKey::SharedItemRole, AttributeKey::DownloadingStatus,
    AttributeKey::DocumentIdentifier};

PromiseRecord wholeRecord()
{
    PromiseRecord record;
    record.size = 12'345;
    record.created = platform::Date{1'600'000'000'123'456'789};
    record.modified = platform::Date{1'650'000'000'000'000'001};
    record.type = "public.pdf";
    record.shared = true;
    record.role = SharedItemRole::Participant;
    record.extensionHidden = true;
    record.documentIdentifier = 4'000'000'000;
    record.tags = {"Two words", "späte \"Arbeit\" \\ \n", "مهم", "🎂"};
    record.content = "0123abcd";
    return record;
}

class PromiseTests : public testing::Test {
protected:
    platform::PromisedItems& items() { return _drive.cloud->promisedItems(); }
    std::string writeRawPromise(std::string_view text) const
    {
        return _drive.writeDocument(".Plan.pdf.trwpromise", text).path();
    }

    DriveFixture _drive;
};

TEST(PromiseRecordTests, whatIsWrittenIsReadBack)
{
    auto record = wholeRecord();
    EXPECT_EQ(PromiseRecord::parse(record.toJson()), record);
    for (const auto kind : {PromiseRecord::Kind::Directory, PromiseRecord::Kind::Package}) {
        record.kind = kind;
        EXPECT_EQ(PromiseRecord::parse(record.toJson()), record);
    }
    EXPECT_EQ(PromiseRecord::parse(PromiseRecord().toJson()), PromiseRecord());
}

TEST(PromiseRecordTests, onlyOneWholeObjectIsARecord)
{
    auto json = wholeRecord().toJson();
    json.pop_back();
    for (std::size_t length = 0; length < json.size(); ++length)
        EXPECT_FALSE(PromiseRecord::parse(json.substr(0, length))) << length;
    const std::string deep(host::drive::PromiseRecord::maximumFileSize / 2, '[');
    for (const std::string& text : {json + "x", json + json, std::string("[]"), std::string("null"),
             std::string("{\"size\" 1}"), std::string("{\"size\":1,}"), std::string("{,}"),
             std::string("{1:2}"), std::string("{\"a\":01}"), std::string("{\"a\":1.}"),
             std::string("{\"a\":1e400}"), std::string("{\"a\":tru}"), std::string("{\"tags\":[1,]}"),
             std::string("{\"a\":\"\\ud800\"}"), std::string("{\"a\":\"\\u0000\"}"),
             std::string("{\"a\":\"\\x\"}"), std::string("{\"a\":\"\xff\"}"), std::string("{\"a\":\"\n\"}"),
             "{\"a\":" + deep, "{\"tags\":" + deep})
        EXPECT_FALSE(PromiseRecord::parse(text)) << text.substr(0, 60);
}

TEST(PromiseRecordTests, aChangedByteNeverYieldsMoreThanARecord)
{
    const auto whole = wholeRecord().toJson();
    for (std::size_t at = 0; at < whole.size(); ++at) {
        for (const unsigned char byte : {0x00, 0x22, 0x2c, 0x30, 0x5b, 0x5c, 0x7b, 0x7d, 0x80, 0xf4, 0xff}) {
            auto text = whole;
            text[at] = static_cast<char>(byte);
            if (const auto record = PromiseRecord::parse(text)) {
                EXPECT_EQ(PromiseRecord::parse(record->toJson()), record) << at << ' ' << int{byte};
            }
        }
    }
}

TEST(PromiseRecordTests, aFieldThatCannotBeRightIsUnknown)
{
    for (const char* size : {"-1", "2.5", "99999999999999999999", "\"12\"", "null", "[1,[2]]"}) {
        const auto record =
            PromiseRecord::parse(std::string("{\"size\":") + size + ",\"modified\":" + size + "}");
        ASSERT_TRUE(record) << size;
        EXPECT_FALSE(record->size) << size;
    }
    const auto record = PromiseRecord::parse(
        R"({"modified": -11644473600000000000, "role": "king", "documentIdentifier": 4294967296, "tags": [1, "", "a"],
            "unknown": {"deep": [true, false, null, -1.5e3]}, "kind": 3, "shared": "yes"})");
    ASSERT_TRUE(record);
    EXPECT_FALSE(record->modified);
    EXPECT_FALSE(record->role);
    EXPECT_EQ(record->documentIdentifier, 0u);
    EXPECT_THAT(record->tags, ElementsAre("a"));
    EXPECT_EQ(record->kind, PromiseRecord::Kind::File);
    EXPECT_FALSE(record->shared);
}

TEST_F(PromiseTests, isDescribedWithoutItsContent)
{
    const auto url = _drive.writePromise("Plan.pdf", wholeRecord());
    EXPECT_FALSE(items().checkPromisedItemIsReachable(url));
    const auto values = items().promisedItemResourceValues(url, allKeys);
    ASSERT_TRUE(values);
    EXPECT_EQ(values->optional<std::string>(AttributeKey::Name), "Plan.pdf");
    EXPECT_EQ(values->optional<std::string>(AttributeKey::LocalizedName), "Plan")
        << "its extension is hidden";
    EXPECT_EQ(values->optional<std::string>(AttributeKey::TypeIdentifier), "public.pdf");
    EXPECT_EQ(values->optional<std::uint64_t>(AttributeKey::FileSize), 12'345u);
    EXPECT_EQ(values->optional<platform::Date>(AttributeKey::CreationDate), wholeRecord().created);
    EXPECT_EQ(
        values->optional<platform::Date>(AttributeKey::ContentModificationDate), wholeRecord().modified);
    EXPECT_EQ(values->optional<DownloadingStatus>(AttributeKey::DownloadingStatus),
        DownloadingStatus::NotDownloaded);
    EXPECT_EQ(values->optional<SharedItemRole>(AttributeKey::SharedItemRole), SharedItemRole::Participant);
    EXPECT_TRUE(values->flag(AttributeKey::IsShared));
    EXPECT_EQ(values->optional<std::uint64_t>(AttributeKey::DocumentIdentifier), 4'000'000'000u);
    EXPECT_EQ(items().readItem(url, {}).tagNames, wholeRecord().tags);
    EXPECT_TRUE(items().resourceValues(url, allKeys).error->is(FileErrorCode::NoSuchItem));
}

TEST_F(PromiseTests, kindsOfPromisedFolders)
{
    const struct {
        const char* name;
        PromiseRecord::Kind kind;
        const char* type;
        bool isDirectory, isPackage;
    } rows[] = {
        {"Folder", PromiseRecord::Kind::Directory, "public.directory", true, false},
        {"Bundle.rtfd", PromiseRecord::Kind::Directory, "public.rtf-directory", true, true},
        {"Thing.unheardof", PromiseRecord::Kind::Package, "public.package", true, true},
    };
    for (const auto& row : rows) {
        PromiseRecord record;
        record.kind = row.kind;
        const auto values =
            items().promisedItemResourceValues(_drive.writePromise(row.name, record), allKeys);
        ASSERT_TRUE(values) << row.name;
        EXPECT_EQ(values->optional<std::string>(AttributeKey::TypeIdentifier), row.type) << row.name;
        EXPECT_EQ(values->flag(AttributeKey::IsDirectory), row.isDirectory) << row.name;
        EXPECT_EQ(values->flag(AttributeKey::IsPackage), row.isPackage) << row.name;
        EXPECT_FALSE(values->has(AttributeKey::FileSize)) << row.name;
    }
}

TEST_F(PromiseTests, physicalAndLogicalLocations)
{
    const auto promised = _drive.writePromise("Notes/Plan.pdf", {});
    const auto physical = items().physicalURLForPromise(promised);
    EXPECT_EQ(physical, _drive.url("Notes/.Plan.pdf.trwpromise"));
    EXPECT_TRUE(items().isItemPromise(physical));
    EXPECT_EQ(items().logicalURLForPromise(physical), promised);

    const auto here = _drive.writeDocument("here.txt");
    const auto nothing = _drive.url("nothing.txt");
    for (const auto& url : {here, nothing}) {
        EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url)) << url.path();
        EXPECT_FALSE(items().isItemPromise(url)) << url.path();
        EXPECT_TRUE(items().logicalURLForPromise(url).isSameObject(url)) << url.path();
    }
    for (const char* name : {".trwpromise", "..trwpromise", "Plan.pdf.trwpromise", ".gone.trwpromise"})
        EXPECT_FALSE(items().isItemPromise(_drive.url(name))) << name;
}

TEST_F(PromiseTests, theRealItemCountsWhereBothExist)
{
    auto record = wholeRecord();
    const auto url = _drive.writePromise("Plan.pdf", record);
    _drive.writeDocument("Plan.pdf", "real");
    EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url));
    const auto values = items().promisedItemResourceValues(url, allKeys);
    ASSERT_TRUE(values);
    EXPECT_EQ(values->optional<std::uint64_t>(AttributeKey::FileSize), 4u);
    EXPECT_FALSE(values->has(AttributeKey::DownloadingStatus));
    EXPECT_TRUE(items().readItem(url, {}).tagNames.empty());

    // A broken link is an item as well.
    const auto link = _drive.writePromise("Link.pdf", record);
    _drive.writeLink("Link.pdf", "nowhere");
    EXPECT_EQ(items()
                  .promisedItemResourceValues(link, allKeys)
                  ->optional<std::string>(AttributeKey::TypeIdentifier),
        "public.symlink");
}

TEST_F(PromiseTests, aDamagedPromiseIsAnErrorOfItsOwnAndOneLine)
{
    const auto whole = wholeRecord().toJson();
    std::vector<std::string> texts{
        "garbage", std::string(PromiseRecord::maximumFileSize + 1, ' '), std::string(300, '\0')};
    for (std::size_t length = 0; length + 1 < whole.size(); length += 7)
        texts.push_back(whole.substr(0, length));
    const auto url = _drive.url("Plan.pdf");
    for (const auto& text : texts) {
        const auto path = writeRawPromise(text);
        _drive.log->clear();
        const auto reading = items().readItem(url, allKeys);
        EXPECT_FALSE(reading.unreachable);
        EXPECT_FALSE(reading.values) << text.substr(0, 40);
        EXPECT_FALSE(reading.values.error->is(FileErrorCode::NoSuchItem));
        EXPECT_TRUE(reading.tagNames.empty());
        EXPECT_THAT(_drive.log->lines(), ElementsAre(StartsWith("ERROR Cannot use the promise " + path)));
        EXPECT_EQ(std::filesystem::file_size(path), text.size()) << "it is left as it is";
    }
}

TEST_F(PromiseTests, whatIsNoPlainFileIsNoPromise)
{
    const auto url = _drive.url("Plan.pdf");
    const auto path = PromiseRecord::pathFor(url.path());
    _drive.writeDocument("target.json", wholeRecord().toJson());
    const std::function<void()> makes[] = {
        [&] { std::filesystem::create_directory(path); },
        [&] { std::filesystem::create_symlink("target.json", path); },
        [&] { ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0); },
    };
    for (const auto& make : makes) {
        make();
        const auto values = items().promisedItemResourceValues(url, allKeys);
        EXPECT_FALSE(values);
        EXPECT_FALSE(values.error->is(FileErrorCode::NoSuchItem));
        std::filesystem::remove(path);
    }
}

TEST_F(PromiseTests, aNameTooLongForAPromiseIsSimplyMissing)
{
    const auto url = _drive.url(std::string(250, 'n'));
    EXPECT_TRUE(items().checkPromisedItemIsReachable(url)->is(FileErrorCode::NoSuchItem));
    EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url));
    EXPECT_TRUE(_drive.log->lines().empty());
}

} // namespace
