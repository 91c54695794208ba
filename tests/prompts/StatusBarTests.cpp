// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/Screen.h"
#include "kit/views/Label.h"
#include "platform/Services.h"
#include "prompts/DocumentListControllerStatusBar.h"
#include "prompts/DriveStatusLabelView.h"
#include "screens/StorageUpgradeButton.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/SimulatedOffers.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

namespace tarrow {
namespace {

using namespace testing_support;

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

TEST_F(StatusBarTest, TheButtonFollowsTheOffer)
{
    const auto named = SimulatedOffers::make(2, true), plain = SimulatedOffers::make(2, true);
    plain->buttonTitle.clear();
    struct Row {
        std::shared_ptr<platform::StorageOffer> offer;
        bool shown;
        const char* title;
    };
    for (const auto& row : {Row{named, true, "Upgrade"}, {nullptr, false, "Upgrade Storage"},
             {SimulatedOffers::make(2, false), false, "Upgrade"}, {plain, true, "Upgrade Storage"}}) {
        bar->showUpgradeOffer(row.offer);
        EXPECT_EQ(view().showLowQuota(), row.shown);
        EXPECT_EQ(button().isHidden(), !row.shown);
        EXPECT_EQ(button().titleLabel()->text(), row.title);
    }
}

TEST_F(StatusBarTest, APressGoesToTheLinkFirstAndToTheDelegateOnlyWithCodeThree)
{
    struct Row {
        int action;
        bool hasDefaultAction;
        int expectedPresses;
    };
    for (const Row row : {Row{3, false, 1}, {3, true, 0}, {1, false, 0}}) {
        SCOPED_TRACE(row.action);
        delegate->presses = 0;
        log->clear();
        offers->hasDefaultAction = row.hasDefaultAction;
        bar->showUpgradeOffer(SimulatedOffers::make(1, true, row.action));
        EXPECT_TRUE(button().press());
        EXPECT_EQ(delegate->presses, row.expectedPresses);
        EXPECT_EQ(
            log->count("INFO UpgradeStorage button pressed, link.action=" + std::to_string(row.action)), 1);
        EXPECT_THAT(log->activities(), testing::ElementsAre("Pressed Upgrade Storage"));
    }
    offers->hasDefaultAction = false;
    delegate = nullptr;
    bar->showUpgradeOffer(SimulatedOffers::make(1, true, 3));
    EXPECT_TRUE(button().press()) << "nobody is there to take it";
}

} // namespace
} // namespace tarrow
