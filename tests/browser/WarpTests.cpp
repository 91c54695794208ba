// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"
#include "items/FileUtils.h"
#include "kit/controllers/AlertController.h"
#include "kit/views/Button.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewItemManager.h"
#include "screens/DocumentInteractionSheet.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"
#include "screens/preview/PreviewScreenView.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Url;
using screens::MoveTargetPicker;
using testing::ElementsAre;

constexpr auto top = "BrindleDefault";

/// Keeps every movement going until the test ends it.
class SlowScreen : public kit::NavigationObserver {
public:
    void navigationWillTransition(
        kit::NavigationController&, const kit::NavigationTransition&, kit::TransitionToken token) override
    {
        movement = std::move(token);
    }
    void stackDidChange(kit::NavigationController&) override { }
    void toolbarVisibilityDidChange(kit::NavigationController&, bool) override { }

    kit::TransitionToken movement;
};

/// Requests from outside that arrive in the middle of another action.
class WarpTest : public BrowserFixture {
protected:
    void open(const Url& document)
    {
        browser->documentListControllerDidSelectItemAtURL(topList(), document);
        settle();
    }
    Url shownItem() const { return browser->itemManager()->item()->url(); }
};

TEST_F(WarpTest, AQuestionThatIsOpenIsDroppedUnanswered)
{
    const auto first = write("first.txt");
    write("Folder/second.txt");
    launch();
    open(first);
    const auto askToDelete = [this] {
        LookwellItemController::defaultController()->showWarningAndDeleteDocument(nullptr);
        settle();
    };
    askToDelete();
    ASSERT_NE(alert(), nullptr);
    EXPECT_TRUE(warp("Folder/second.txt"));
    EXPECT_EQ(alert(), nullptr);
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
    EXPECT_TRUE(FileUtils::exists(first));

    // A refused request closes the question as well, and leaves the rest as it is.
    askToDelete();
    ASSERT_NE(alert(), nullptr);
    EXPECT_FALSE(warp("../../trash/second.txt"));
    EXPECT_EQ(alert(), nullptr);
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
    EXPECT_TRUE(browser->itemManager()->filePresenterRegistered());
}

TEST_F(WarpTest, AMoveThatIsRunningEndsWithoutPullingTheScreenAlong)
{
    const auto first = write("first.txt");
    write("Folder/second.txt");
    drive.makeFolder("Target");
    launch();
    open(first);
    LookwellItemController::defaultController()->showMoveTarget(nullptr);
    settle();
    const auto picker = std::dynamic_pointer_cast<MoveTargetPicker>(browser->presentedViewController());
    ASSERT_NE(picker, nullptr);
    picker->choose(url("Target"));
    EXPECT_TRUE(FileUtils::exists(first)) << "not begun";
    EXPECT_TRUE(warp("Folder/second.txt", PreviewModeDetails));
    EXPECT_TRUE(FileUtils::exists(url("Target/first.txt"))) << "what was asked for happens";
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "i"));
    EXPECT_EQ(shownItem(), url("Folder/second.txt"));
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(WarpTest, ADocumentThatIsTappedWhileItsListMovesInKeepsItsManager)
{
    const auto note = write("Folder/note.txt");
    launch();
    const auto slow = std::make_shared<SlowScreen>();
    browser->setNavigationObserver(slow);
    const std::function<void()> ways[] = {[&] { open(note); }, [&] { warp("Folder/note.txt"); }};
    for (const auto& way : ways) {
        browser->documentListControllerDidSelectContainerWithViewController(
            topList(), screens::DocumentListController::initWithURL(url("Folder")));
        EXPECT_TRUE(browser->isTransitioning());
        way();
        slow->movement.finish();
        EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
        ASSERT_NE(browser->itemManager(), nullptr);
        EXPECT_EQ(LookwellItemController::defaultController()->itemManager(), browser->itemManager());
        browser->popToRootViewController(false);
        slow->movement.finish();
        settle();
        EXPECT_EQ(browser->itemManager(), nullptr);
    }
}

TEST_F(WarpTest, APreviewThatCannotShowADocumentOffersOtherApps)
{
    using screens::PlaceholderView;
    const auto document = write("Folder/data.bin");
    launch();
    EXPECT_TRUE(warp("Folder/data.bin"));
    const auto screen = LookwellItemController::defaultController();
    const auto shown = std::dynamic_pointer_cast<PlaceholderView>(screen->screenView()->content());
    ASSERT_TRUE(shown && shown->buttons().size() == 1);
    shown->buttons().front()->press();
    settle();
    ASSERT_NE(browser->itemManager()->documentInteractionController(), nullptr);
    EXPECT_EQ(browser->itemManager()->documentInteractionController()->url(), document);
    EXPECT_NE(alert(), nullptr) << "its menu";
}

TEST_F(WarpTest, ADocumentThatOthersTakeAwayClosesItsPreview)
{
    write("Folder/note.txt");
    launch();
    EXPECT_TRUE(warp("Folder/note.txt"));
    EXPECT_FALSE(FileUtils::remove(url("Folder")));
    settle();
    EXPECT_EQ(browser->itemManager(), nullptr);
    EXPECT_THAT(stack(), testing::Not(testing::Contains("*")));
}

TEST_F(WarpTest, WhatIsDoneFromAPeekLeavesTheListWhereItIs)
{
    const auto note = write("note.txt");
    launch();
    browser->documentListControllerViewControllerForPreviewingItemAtURL(topList(), note);
    settle();
    EXPECT_FALSE(FileUtils::moveTo(note, url("renamed.txt")));
    settle();
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_EQ(shownItem(), url("renamed.txt"));
    browser->knopPopToURL(url("renamed.txt"));
    settle();
    EXPECT_THAT(stack(), ElementsAre(top, "*"));
    EXPECT_EQ(
        LookwellItemController::defaultController()->arrayOfDocuments(), std::vector{url("renamed.txt")});
}

} // namespace
} // namespace tarrow
