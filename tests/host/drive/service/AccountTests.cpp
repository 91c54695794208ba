// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/KeyValueStore.h"
#include "platform/LinkOpener.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace host::drive;
using namespace platform;
using testing_support::DriveFixture;

class RecordingOpener : public LinkOpener {
public:
    void openLink(const std::string& url, Completion completion) override
    {
        opened.push_back(url);
        completion(std::nullopt);
    }
    std::vector<std::string> opened;
};

/// A test of what is read from the account's files, which counts the notices of one kind.
template <Notification notification>
class FileTests : public testing::Test {
protected:
    /// Writes a file as another program does, and lets the drive hear of it.
    void write(const std::string& path, std::string_view text) const
    {
        std::ofstream(path, std::ios::trunc) << text;
        _drive.settle();
    }

    DriveFixture _drive;
    int _notices = 0;

private:
    Observation _observation =
        _drive.notifications->observe(notification, [this](const auto&) { ++_notices; });
};

class AccountTests : public FileTests<Notification::CloudIdentityDidChange> {
protected:
    std::optional<PropertyValue> token() { return _drive.cloud->account().identityToken(); }
};

TEST_F(AccountTests, tellsOfEveryChangeOfIdentityOnceAndOfNothingElse)
{
    const auto first = token();
    ASSERT_TRUE(first);

    write(_drive.layout().account(), R"({"identity": "account-1", "displayName": "Renamed"})");
    EXPECT_EQ(token(), first);
    EXPECT_EQ(_notices, 0) << "the same identity written again is no change";

    _drive.signIn("Jonas");
    _drive.settle();
    const auto second = token();
    EXPECT_TRUE(second && second != first);
    EXPECT_EQ(_notices, 1);

    // The file is replaced by a rename, as careful programs do.
    const auto prepared = _drive.folder().write("drive/new", R"({"identity": "account-1"})");
    std::filesystem::rename(prepared, _drive.layout().account());
    _drive.settle();
    EXPECT_EQ(token(), first);
    EXPECT_EQ(_notices, 2);

    _drive.signOut();
    _drive.settle();
    EXPECT_FALSE(token());
    EXPECT_EQ(_notices, 3);
    EXPECT_FALSE(_drive.cloud->containers().defaultContainerURL());

    write(_drive.layout().home() + "/unrelated.json", "{}");
    EXPECT_EQ(_notices, 3);
}

TEST_F(AccountTests, followsAFolderThatGoesAwayAndComesBack)
{
    const auto home = _drive.layout().home();
    std::filesystem::rename(home, home + "-away");
    _drive.settle();
    EXPECT_EQ(_notices, 1);
    EXPECT_FALSE(token());

    std::filesystem::rename(home + "-away", home);
    _drive.dispatch->advance(10);
    EXPECT_EQ(_notices, 2);
    _drive.signIn("Jonas");
    _drive.settle();
    EXPECT_EQ(_notices, 3) << "the folder is watched again";
}

TEST_F(AccountTests, quotaIsTheFreeSpaceOrTheSystemsError)
{
    const auto fetch = [this] {
        std::vector<Result<std::int64_t>> answers;
        _drive.cloud->account().makeQuotaFetchOperation(
            [&](Result<std::int64_t> answer) { answers.push_back(std::move(answer)); })();
        EXPECT_EQ(answers.size(), 1U);
        return answers.front();
    };
    const auto space = std::filesystem::space(_drive.layout().home());
    const auto free = fetch();
    ASSERT_TRUE(free);
    EXPECT_NEAR(static_cast<double>(*free), static_cast<double>(space.available), 1e9);

    std::filesystem::remove_all(_drive.layout().home());
    const auto gone = fetch();
    EXPECT_FALSE(gone);
    EXPECT_TRUE(gone.error && gone.error->is(FileErrorCode::NoSuchItem));
}

class StorageOfferTests : public FileTests<Notification::StorageOfferDidChange> {
protected:
    StorageOfferManager& offers() { return services().storageOfferManager(); }
    void writeOffer(StorageOffer offer) const
    {
        write(_drive.layout().account(), AccountRecord{"account-1", "Mira", std::move(offer)}.toJson());
    }

    const StorageOffer _offer{2, true, "Get More", {1, "https://drive.example/more"}};
};

TEST_F(StorageOfferTests, isReadWhenItIsAskedForAndThenFollowed)
{
    writeOffer(_offer);
    EXPECT_EQ(_notices, 0);
    EXPECT_TRUE(offers().fetchOfferIfNeeded());
    EXPECT_TRUE(offers().fetchOfferIfNeeded()) << "still on its way";
    EXPECT_EQ(offers().currentOffer(), nullptr);
    _drive.settle();
    ASSERT_TRUE(offers().currentOffer());
    EXPECT_EQ(*offers().currentOffer(), _offer);
    EXPECT_EQ(_notices, 1);
    EXPECT_FALSE(offers().fetchOfferIfNeeded());

    writeOffer(_offer);
    EXPECT_EQ(_notices, 1) << "the same offer is no change";
    auto better = _offer;
    better.level = 3;
    writeOffer(better);
    EXPECT_EQ(_notices, 2);
    EXPECT_EQ(offers().currentOffer()->level, 3);
    _drive.signOut();
    _drive.settle();
    EXPECT_EQ(offers().currentOffer(), nullptr);
    EXPECT_EQ(_notices, 3);
}

TEST_F(StorageOfferTests, lowWhenTheFileSystemIsNearlyFull)
{
    const std::pair<StorageSpace, bool> rows[] = {
        {{100, 1000}, false}, {{99, 1000}, true}, {{0, 1000}, true}, {{1000, 1000}, false}, {{0, 0}, false}};
    for (const auto& [space, isLow] : rows)
        EXPECT_EQ(space.isLow(), isLow) << space.free << " of " << space.total;
    auto offer = _offer;
    offer.storageIsLow = false;
    writeOffer(offer);
    offers().fetchOfferIfNeeded();
    _drive.settle();
    EXPECT_EQ(offers().currentOffer()->storageIsLow, StorageSpace::of(_drive.layout().home())->isLow());
}

TEST_F(StorageOfferTests, aMalformedOfferIsNoneAndMalformedPartsAreEmpty)
{
    const auto parsed = [](const std::string& offer) {
        return AccountRecord::parse(R"({"identity": "a", "storageOffer": )" + offer + "}", "account.json");
    };
    for (const char* text : {"null", "[]", "3", "\"offer\""})
        EXPECT_FALSE(parsed(text)->storageOffer) << text;
    EXPECT_EQ(parsed(R"({"level": "x", "storageIsLow": 1, "buttonTitle": [], "link": 4})")->storageOffer,
        StorageOffer());
}

TEST_F(StorageOfferTests, onlyPagesOfTheWebAreOpened)
{
    const auto opener = std::make_shared<RecordingOpener>();
    const auto manager = LocalStorageOfferManager::create(
        _drive.layout(), {_drive.dispatch, _drive.notifications, nullptr, nullptr, opener});
    const struct {
        StorageOfferLink link;
        bool isOpened;
    } rows[] = {
        {{1, "https://drive.example/more"}, true},
        {{3, "https://drive.example/more"}, false},
        {{1, "file:///etc/passwd"}, false},
        {{1, "javascript:alert(1)"}, false},
        {{1, "-option"}, false},
        {{1, ""}, false},
    };
    for (const auto& row : rows)
        EXPECT_EQ(manager->performDefaultAction(row.link), row.isOpened) << row.link.target;
    EXPECT_THAT(opener->opened, testing::ElementsAre("https://drive.example/more"));
}

class KeyValueStoreTests : public FileTests<Notification::KeyValueStoreDidChangeExternally> {
protected:
    static std::optional<PropertyValue> value(const std::string& key)
    {
        return services().keyValueStore().objectForKey(key);
    }
    void write(const std::string& text) const { FileTests::write(_drive.layout().keyValueStore(), text); }
};

TEST_F(KeyValueStoreTests, OnlyWhatChangedIsTold)
{
    EXPECT_EQ(value("a"), std::nullopt);
    write(R"({"a": 1})");
    EXPECT_EQ(_notices, 1);
    EXPECT_EQ(value("a")->asInteger(), 1);
    write(R"({ "a" : 1 })");
    EXPECT_EQ(_notices, 1) << "the same values are no change";
    std::filesystem::remove(_drive.layout().keyValueStore());
    _drive.settle();
    EXPECT_EQ(_notices, 2);
    EXPECT_EQ(value("a"), std::nullopt);
}

TEST_F(KeyValueStoreTests, AFileThatCannotBeUsedIsNamedOnceAndHoldsNothing)
{
    for (const auto& text : {std::string("[1]"), std::string(LocalKeyValueStore::maximumFileSize + 1, ' ')}) {
        write(R"({"a": 1})");
        EXPECT_TRUE(value("a"));
        _drive.log->clear();
        write(text);
        EXPECT_EQ(value("a"), std::nullopt) << text.substr(0, 20);
        EXPECT_EQ(value("b"), std::nullopt);
        EXPECT_EQ(_drive.log->lines().size(), 1U) << text.substr(0, 20);
    }
}

} // namespace
