// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/Screen.h"
#include "kit/views/Label.h"
#include "platform/Services.h"
#include "prompts/DocumentListControllerStatusBar.h"
#include "prompts/DriveStatusLabelView.h"
#include "screens/StorageUpgradeButton.h"
#include "screens/list/DocumentListController.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/SimulatedOffers.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

namespace tarrow {
namespace {

using namespace testing_support;
using kit::SystemItem;
using screens::DocumentListController;

struct CountingDelegate : DocumentListControllerStatusBarDelegate {
    int presses = 0;
    void upgradeStorageButtonPressed() override { ++presses; }
};

class StatusBarTest : public testing::Test {
protected:
    StatusBarTest()
    {
        platform::ServiceSet set;
        set.storageOfferManager = offers;
        set.localization = std::make_shared<PlainTexts>();
        platform::installServices(std::move(set));
        kit::Screen screen;
        screen.scale = 2;
        kit::Screen::setMain(screen);
        bar->createStatusBarButtonPressDelegate(nullptr, delegate);
    }
    ~StatusBarTest() override
    {
        kit::Screen::setMain({});
        platform::installServices({});
        platform::installLogSink(nullptr);
    }

    DriveStatusLabelView& view() { return *bar->labelsView(); }
    screens::StorageUpgradeButton& button() { return *view().quotaButton(); }
    /// Answers the frame of the line in a view of this size.
    platform::Rect lineIn(double width, double height)
    {
        view().setFrame({0, 0, width, height});
        view().layoutIfNeeded();
        return view().primaryLabel()->frame();
    }

    std::shared_ptr<RecordingLog> log = RecordingLog::install();
    std::shared_ptr<SimulatedOffers> offers = std::make_shared<SimulatedOffers>();
    std::shared_ptr<CountingDelegate> delegate = std::make_shared<CountingDelegate>();
    std::shared_ptr<DocumentListControllerStatusBar> bar =
        std::make_shared<DocumentListControllerStatusBar>();
};

// Positions are rounded to half points on this screen.
constexpr double pixel = 0.5;

TEST_F(StatusBarTest, TheLineAndTheTitleAreCentredTogether)
{
    struct Row {
        const char* text;
        bool storageIsLow;
        double width, height;
    };
    for (const Row row : {Row{"12 items", false, 300, 44}, {"12 items", true, 300, 44}, {"", true, 300, 44},
             {"", false, 300, 60}, {"12 items, 3 GB available", true, 361, 57}, {"12 items", true, 0, 0}}) {
        SCOPED_TRACE(std::string(row.text) + (row.storageIsLow ? " low" : ""));
        bar->setStatusText(row.text);
        bar->showUpgradeOffer(SimulatedOffers::make(1, row.storageIsLow));
        const auto line = lineIn(row.width, row.height);
        const auto frame = button().frame();
        const auto title = button().titleLabel()->frame();
        const double textHeight = *row.text ? line.height : 0;
        const double block = row.storageIsLow ? textHeight + line.height / 4 + title.height : textHeight;

        EXPECT_GT(title.height, 1);
        EXPECT_NEAR(line.midX(), row.width / 2, pixel);
        EXPECT_NEAR(frame.midX(), row.width / 2, pixel) << "the button has its place even while hidden";
        EXPECT_NEAR(line.y, (row.height - block) / 2 - 1, pixel);
        const double gap = row.storageIsLow ? line.height / 4 : 0;
        EXPECT_NEAR(frame.midY() - title.height / 2, line.maxY() + gap, pixel);
        EXPECT_EQ(button().isHidden(), !row.storageIsLow);
        for (const double edge : {line.x, line.y, frame.x, frame.y})
            EXPECT_DOUBLE_EQ(edge * 2, std::round(edge * 2)) << "on the pixel grid";
    }
}

TEST_F(StatusBarTest, TheToolbarHoldsTheContentBetweenTwoSpaces)
{
    ASSERT_EQ(bar->toolbarItems().size(), 3);
    EXPECT_EQ(bar->toolbarItems()[0]->systemItem(), SystemItem::FlexibleSpace);
    EXPECT_EQ(bar->toolbarItems()[1]->customView(), bar->labelsView());
    EXPECT_EQ(bar->toolbarItems()[2]->systemItem(), SystemItem::FlexibleSpace);
    EXPECT_EQ(view().primaryLabel()->font().sizing, kit::TextSizing::Fixed);
}

TEST_F(StatusBarTest, TheButtonFollowsTheOffer)
{
    const auto low = SimulatedOffers::make(2, true);
    struct Row {
        std::shared_ptr<platform::StorageOffer> offer;
        bool shown;
    };
    for (const auto& row :
        {Row{low, true}, {nullptr, false}, {SimulatedOffers::make(2, false), false}, {low, true}}) {
        bar->showUpgradeOffer(row.offer);
        EXPECT_EQ(view().showLowQuota(), row.shown);
        EXPECT_EQ(button().isHidden(), !row.shown);
        EXPECT_EQ(button().offer(), row.offer);
    }
    bar->showUpgradeOffer(SimulatedOffers::make(2, true));
    EXPECT_EQ(button().offer(), low) << "an equal offer is not assigned again";
    view().showLowQuota(false);
    bar->showUpgradeOffer(low);
    EXPECT_FALSE(button().isHidden()) << "but whether it is shown is judged again";
}

TEST_F(StatusBarTest, APressGoesToTheLinkFirstAndToTheDelegateOnlyWithCodeThree)
{
    struct Row {
        int action;
        bool hasDefaultAction;
        int expectedPresses;
    };
    for (const Row row : {Row{3, false, 1}, {3, true, 0}, {1, false, 0}, {0, false, 0}, {4, true, 0}}) {
        SCOPED_TRACE(row.action);
        delegate->presses = 0;
        log->clear();
        offers->hasDefaultAction = row.hasDefaultAction;
        bar->showUpgradeOffer(SimulatedOffers::make(1, true, row.action));
        EXPECT_TRUE(button().press());
        EXPECT_EQ(delegate->presses, row.expectedPresses);
        EXPECT_EQ(
            log->count("INFO UpgradeStorage button pressed, link.action=" + std::to_string(row.action)), 1);
        EXPECT_EQ(log->count("INFO UpgradeStorage button pressed, launched default action (Manage Storage?)"),
            row.hasDefaultAction ? 1 : 0);
        EXPECT_THAT(log->activities(), testing::ElementsAre("Pressed Upgrade Storage"));
    }
    offers->hasDefaultAction = false;
    delegate = nullptr;
    bar->showUpgradeOffer(SimulatedOffers::make(1, true, 3));
    EXPECT_TRUE(button().press()) << "nobody is there to take it";
}

TEST_F(StatusBarTest, AListOwnsItsStatusBar)
{
    auto list = std::make_shared<DocumentListController>(std::nullopt);
    EXPECT_EQ(statusBar(*list), nullptr);
    displayStatusBar(*list);
    EXPECT_TRUE(list->toolbarItems().empty());

    createStatusBarButtonPressDelegate(*list, SimulatedOffers::make(1, true), delegate);
    const std::weak_ptr<DocumentListControllerStatusBar> first = statusBar(*list);
    EXPECT_EQ(first.lock()->delegate(), delegate);
    displayStatusBar(*list);
    EXPECT_EQ(list->toolbarItems(), first.lock()->toolbarItems());

    createStatusBarButtonPressDelegate(*list, nullptr, delegate);
    EXPECT_TRUE(first.expired()) << "the second one replaced it";
    const std::weak_ptr<DocumentListControllerStatusBar> second = statusBar(*list);
    list = nullptr;
    EXPECT_TRUE(second.expired());
}

} // namespace
} // namespace tarrow
