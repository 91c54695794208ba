// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"
#include "kit/views/Label.h"
#include "prompts/DriveStatusLabelView.h"
#include "screens/StorageUpgradeButton.h"
#include "screens/UpgradeFlow.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Notification;

class StatusTest : public BrowserFixture {
protected:
    DriveStatusLabelView& view(std::size_t index = 0) const
    {
        const auto list =
            std::dynamic_pointer_cast<screens::DocumentListController>(browser->viewControllers().at(index));
        return *statusBar(*list)->labelsView();
    }
    const std::string& statusText() const { return view().primaryLabel()->text(); }
};

TEST_F(StatusTest, TheLineHasTheItemsAndOnceItIsKnownTheFreeStorage)
{
    cloud->quota = platform::Error(platform::errorDomain::cloud, 1);
    const auto launched = dispatch->now();
    launchWithoutListing();
    EXPECT_FALSE(browser->pickerIsAlive());
    EXPECT_EQ(statusText(), "") << "nothing is said before the list has reported";
    settle();
    EXPECT_TRUE(browser->pickerIsAlive());
    EXPECT_EQ(statusText(), browser->toolbarStatusText(topList()->containedItemCount()));
    EXPECT_EQ(statusText().find(','), std::string::npos);

    cloud->quota = std::int64_t{3} << 30;
    dispatch->advance(301);
    EXPECT_EQ(browser->quotaBytes(), std::uint64_t{3} << 30);
    EXPECT_EQ(browser->lastQuotaFetch(), platform::Date{launched.nanoseconds + 300'000'000'000});
    EXPECT_EQ(statusText(), itemsText(topList()->containedItemCount()) + ", 3 GB available");
}

TEST_F(StatusTest, TheLineSaysThatTheDriveIsPutRight)
{
    cloud->putsRight = true;
    launch();
    EXPECT_EQ(statusText(), "Putting things right…");
    cloud->putsRight = false;
    post(Notification::PuttingRightDidChange);
    EXPECT_EQ(statusText(), browser->toolbarStatusText(topList()->containedItemCount()));
    EXPECT_NE(statusText(), "Putting things right…");
}

TEST_F(StatusTest, TheOfferAtLaunchIsTakenUnlessItIsStillBeingFetched)
{
    offers->offer = SimulatedOffers::make(4, true);
    launch();
    EXPECT_EQ(browser->upgradeOffer(), offers->offer);
    EXPECT_EQ(log->count("INFO Quota Offer level is 4"), 1);

    offers->fetchStarts = true;
    log->clear();
    launch();
    EXPECT_EQ(browser->upgradeOffer(), nullptr);
    EXPECT_EQ(log->count("INFO Quota Offer level is not set"), 1);
    post(Notification::StorageOfferDidChange);
    EXPECT_EQ(browser->upgradeOffer(), offers->offer);
    EXPECT_EQ(log->count("INFO Quota Offer Changed, offer level is 4"), 1);
}

TEST_F(StatusTest, AnOfferReachesEveryListAndTheQuotaIsFetchedThreeTimes)
{
    write("Folder/a.txt", "a");
    launch();
    warp("Folder");
    EXPECT_THAT(view(1).primaryLabel()->text(), testing::StartsWith(itemsText(1)));
    // Only a list that was on top has a status bar.
    browser->popViewController(false);
    settle();
    const int before = cloud->requests;
    offers->offer = SimulatedOffers::make(1, true);
    platform::services().notificationCenter().post(Notification::StorageOfferDidChange);
    EXPECT_TRUE(view().showLowQuota());

    struct Row {
        double seconds;
        int fetches;
    };
    for (const Row row : {Row{0.9, 0}, {0.2, 1}, {3.8, 1}, {0.2, 2}, {14.8, 2}, {0.2, 3}, {30, 3}}) {
        dispatch->advance(row.seconds);
        EXPECT_EQ(cloud->requests - before, row.fetches);
    }
    offers->offer = nullptr;
    post(Notification::StorageOfferDidChange);
    EXPECT_FALSE(view().showLowQuota());
}

TEST_F(StatusTest, TheUpgradeButtonStartsTheFlow)
{
    launch();
    browser->upgradeStorageButtonPressed();
    EXPECT_EQ(log->count("INFO UpgradeStorage: No upgrade offer"), 1);
    EXPECT_EQ(browser->presentedViewController(), nullptr);

    offers->offer = SimulatedOffers::make(1, true);
    post(Notification::StorageOfferDidChange);
    EXPECT_TRUE(view().quotaButton()->press());
    settle();
    EXPECT_EQ(log->count("INFO UpgradeStorage: presenting view controller"), 1);
    EXPECT_NE(browser->presentedViewController(), nullptr);
}

} // namespace
} // namespace tarrow
