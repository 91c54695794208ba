// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/UndoHistory.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/TextField.h"
#include "preview/PreviewItemManager.h"
#include "prompts/FilenamePrompt.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Notification;
using platform::Url;
using testing::ElementsAre;
using testing::IsEmpty;

class UndoTest : public BrowserFixture {
protected:
    void move(const std::vector<Url>& items, const char* folder)
    {
        browser->moveItemsToDirectoryAndShowErrorsToDirectory(items, url(folder));
        settle();
    }
    /// Types a name into the prompt on the screen and confirms it.
    void enter(const std::string& name)
    {
        const auto prompt = browser->folderPromptAlert();
        prompt->alert()->textFields().front()->userEdited(name, {name.size(), 0});
        prompt->alert()->press(1);
        settle();
    }
    bool pressUndo()
    {
        const bool isTaken = window->undoRequested();
        settle();
        return isTaken;
    }
    bool isThere(std::string_view path) const { return std::filesystem::exists(url(path).path()); }
};

TEST_F(UndoTest, WhatAPersonChangesIsToldAndCanBeUndone)
{
    const auto a = write("a.txt"), b = write("b.txt");
    write("Trip/c.txt");
    launch();
    struct Row {
        std::function<void()> change;
        const char *notice, *made;
    };
    const Row rows[] = {
        {[&] { move({a}, "Trip"); }, "“a.txt” was moved to “Trip”", "Trip/a.txt"},
        {[&] {
             move({a, b}, "Trip");
         },
            "2 items were moved to “Trip”", "Trip/b.txt"},
        {[&] {
             browser->showRenamePrompt(a);
             settle();
             enter("new");
         },
            "“a.txt” is now called “new.txt”", "new.txt"},
        {[&] {
             browser->promtForNewFolderAndCreate(nullptr);
             enter("Notes");
         },
            "The folder “Notes” was created", "Notes"},
        {[&] {
             browser->showNewFolderPromptDuringMoveItemsToMove(topList()->presentedURL(), {a, b});
             enter("Both");
         },
            "2 items were moved to “Both”", "Both/a.txt"},
    };
    for (const auto& row : rows) {
        for (const bool byKey : {false, true}) {
            row.change();
            EXPECT_THAT(takeNotices(), ElementsAre(row.notice));
            EXPECT_TRUE(isThere(row.made));
            if (byKey)
                EXPECT_TRUE(pressUndo());
            else
                pressNotice();
            EXPECT_FALSE(isThere(row.made)) << row.notice;
            EXPECT_TRUE(isThere("a.txt") && isThere("b.txt")) << row.notice;
            EXPECT_THAT(takeNotices(), ElementsAre("Undone: " + std::string(row.notice)));
        }
        pressNotice();
    }
    EXPECT_FALSE(isThere("Both"));
    EXPECT_FALSE(pressUndo()) << "everything is undone";
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(UndoTest, SaysWhatCouldNotBeUndone)
{
    const auto a = write("a.txt"), b = write("b.txt"), c = write("c.txt");
    write("Trip/d.txt");
    launch();
    move({a, b, c}, "Trip");
    write("a.txt", "another"), write("b.txt", "another");
    pressUndo();
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->title(), "2 items couldn’t be changed back.");
    EXPECT_EQ(alert()->message(),
        "“a.txt” wasn’t put back, because its old place is taken.\n"
        "“b.txt” wasn’t put back, because its old place is taken.");
    EXPECT_TRUE(isThere("c.txt"));
    EXPECT_FALSE(pressUndo()) << "the alert lies over the list";
    alert()->press(0);
    settle();

    move({c}, "Trip");
    write("c.txt", "another");
    pressUndo();
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->title(), "“c.txt” wasn’t put back, because its old place is taken.");
}

TEST_F(UndoTest, TheHistoryEndsWithTheAccount)
{
    const auto a = write("a.txt");
    write("Trip/b.txt");
    launch();
    move({a}, "Trip");
    cloud->token.reset();
    post(Notification::CloudIdentityDidChange);
    cloud->token = platform::PropertyValue("account-1");
    post(Notification::CloudIdentityDidChange);
    pressNotice();
    EXPECT_FALSE(pressUndo());
    EXPECT_TRUE(isThere("Trip/a.txt"));
}

TEST_F(UndoTest, AMoveFromThePreviewIsToldOnceAndCanBeUndone)
{
    const auto a = write("a.txt");
    write("Trip/b.txt");
    launch();
    warp("a.txt", PreviewModeDetails);
    takeNotices();
    const auto manager = browser->itemManager();
    manager->showMoveTarget(browser->topViewController());
    settle();
    const auto picker =
        std::dynamic_pointer_cast<screens::MoveTargetPicker>(browser->presentedViewController());
    ASSERT_NE(picker, nullptr);
    manager->documentTargetSelectionControllerDidSelectItemAtURL(picker, url("Trip"));
    settle();
    EXPECT_THAT(takeNotices(), ElementsAre("“a.txt” was moved to “Trip”"));
    EXPECT_THAT(stack(), ElementsAre("BrindleDefault", "Trip", "i"));
    EXPECT_TRUE(pressUndo());
    EXPECT_TRUE(isThere("a.txt"));
    EXPECT_THAT(stack(), ElementsAre("BrindleDefault", "i"));
}

} // namespace
} // namespace tarrow
