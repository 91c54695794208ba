// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/StorageSpace.h"
#include "platform/LinkOpener.h"
#include "tests/support/DriveFixture.h"

namespace {

using namespace host::drive;
using platform::StorageOffer;
using testing::ElementsAre;
using testing_support::DriveFixture;

class RecordingOpener : public platform::LinkOpener {
public:
    void openLink(const std::string& url, Completion completion) override
    {
        opened.push_back(url);
        completion(std::nullopt);
    }
    std::vector<std::string> opened;
};

class StorageOfferTests : public testing::Test {
protected:
    StorageOfferTests()
        : _observation(_drive.notifications->observe(
            platform::Notification::StorageOfferDidChange, [this](const auto&) { ++_notices; }))
    {
    }

    platform::StorageOfferManager& offers() { return platform::services().storageOfferManager(); }
    void writeOffer(std::optional<StorageOffer> offer) const
    {
        std::ofstream(_drive.layout().account(), std::ios::trunc)
            << AccountRecord{"account-1", "Mira", std::move(offer)}.toJson();
    }

    DriveFixture _drive;
    int _notices = 0;
    platform::Observation _observation;
    const StorageOffer _offer{2, true, "Get More", {1, "https://drive.example/more"}};
};

TEST_F(StorageOfferTests, isReadOnceAndThenFollowed)
{
    writeOffer(_offer);
    EXPECT_TRUE(offers().fetchOfferIfNeeded());
    EXPECT_TRUE(offers().fetchOfferIfNeeded()) << "still on its way";
    EXPECT_EQ(offers().currentOffer(), nullptr);
    _drive.settle();
    ASSERT_TRUE(offers().currentOffer());
    EXPECT_EQ(*offers().currentOffer(), _offer);
    EXPECT_EQ(_notices, 1);
    EXPECT_FALSE(offers().fetchOfferIfNeeded());

    writeOffer(_offer);
    _drive.settle();
    EXPECT_EQ(_notices, 1) << "the same offer is no change";
    auto better = _offer;
    better.level = 3;
    writeOffer(better);
    _drive.settle();
    EXPECT_EQ(_notices, 2);
    EXPECT_EQ(offers().currentOffer()->level, 3);
    _drive.signOut();
    _drive.settle();
    EXPECT_EQ(offers().currentOffer(), nullptr);
    EXPECT_EQ(_notices, 3);
}

TEST_F(StorageOfferTests, isNotReadBeforeItIsAskedFor)
{
    writeOffer(_offer);
    _drive.settle();
    EXPECT_EQ(offers().currentOffer(), nullptr);
    EXPECT_EQ(_notices, 0);
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
        platform::StorageOfferLink link;
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
    EXPECT_THAT(opener->opened, ElementsAre("https://drive.example/more"));
}

} // namespace
