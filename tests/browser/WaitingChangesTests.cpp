// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/BarButtonItem.h"
#include "kit/views/Label.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "platform/Log.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "preview/PreviewItemManager.h"
#include "prompts/DriveStatusLabelView.h"
#include "prompts/FilenamePrompt.h"
#include "prompts/SimpleTextViewController.h"
#include "screens/list/DocumentListAction.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Notification;
using platform::Url;
using screens::DocumentListAction;

/// Something happens while a change that a person has confirmed waits for its turn.
class WaitingChangesTest : public BrowserFixture {
protected:
    /// A name prompt over the root list, and what its confirmation changes.
    struct Prompt {
        const char* name;
        std::function<void()> open;
        const char* typed;
        const char* made; ///< is there when the change has happened
    };
    std::vector<Prompt> prompts()
    {
        return {
            {"rename", [this] { browser->showRenamePrompt(url("a.txt")); }, "b.txt", "b.txt"},
            {"new folder", [this] { browser->promtForNewFolderAndCreate(nullptr); }, "New", "New"},
            {"new folder for an item",
                [this] {
                    browser->showNewFolderPromptDuringMoveItemsToMove(
                        topList()->presentedURL(), {url("a.txt")});
                },
                "New", "New/a.txt"},
        };
    }
    /// Opens a prompt over a fresh drive and confirms it; `happens` runs while the change waits.
    void confirm(const Prompt& prompt, std::function<void()> happens)
    {
        coordinator->whileWaiting = {};
        for (const char* name : {"b.txt", "New"})
            std::filesystem::remove_all(url(name).path());
        cloud->token = platform::PropertyValue("account-1");
        write("a.txt");
        write("other.txt");
        launch();
        post(Notification::ApplicationDidBecomeActive);
        prompt.open();
        settle();
        ASSERT_NE(alert(), nullptr);
        browser->folderPromptAlert()->alert()->textFields().front()->userEdited(prompt.typed, {0, 0});
        EXPECT_FALSE(alert()->press(1)) << "the prompt waits";
        EXPECT_FALSE(isThere(prompt.made)) << "nothing happens within the tap";
        coordinator->whileWaiting = std::move(happens);
        settle();
    }
    /// Answers the message of the prompt on the screen.
    std::string message() const
    {
        return browser->folderPromptAlert()->errMsgViewController()->messageLabel()->text();
    }
    void signOut()
    {
        cloud->token = std::nullopt;
        drive.notifications->post(Notification::CloudIdentityDidChange);
    }
    /// Answers the dimmed rows of the list on top by their names.
    std::vector<std::string> dimmed() const
    {
        std::vector<std::string> names;
        const auto& rows = *topList()->listView();
        for (std::size_t row = 0; row < topList()->containedItemCount(); ++row) {
            if (rows.row(row).isDimmed)
                names.push_back(rows.row(row).title);
        }
        return names;
    }
    bool isThere(std::string_view path) const { return std::filesystem::exists(url(path).path()); }
};

TEST_F(WaitingChangesTest, APromptWaitsAndClosesWithTheChange)
{
    for (const auto& prompt : prompts()) {
        SCOPED_TRACE(prompt.name);
        int waits = 0;
        confirm(prompt, [&] {
            ++waits;
            ASSERT_NE(alert(), nullptr);
            EXPECT_FALSE(alert()->press(1)) << "a second press";
        });
        EXPECT_EQ(alert(), nullptr);
        EXPECT_TRUE(isThere(prompt.made));
        EXPECT_EQ(waits, prompt.made == std::string("New/a.txt") ? 2 : 1);
    }
}

TEST_F(WaitingChangesTest, CancelTakesTheChangeBack)
{
    for (const auto& prompt : prompts()) {
        SCOPED_TRACE(prompt.name);
        confirm(prompt, [this] {
            if (alert())
                alert()->press(0);
        });
        EXPECT_EQ(alert(), nullptr);
        EXPECT_TRUE(isThere("a.txt"));
        EXPECT_FALSE(isThere(prompt.typed));
    }
}

TEST_F(WaitingChangesTest, ASignOutTakesTheChangeBack)
{
    for (const auto& prompt : prompts()) {
        SCOPED_TRACE(prompt.name);
        confirm(prompt, [this] { signOut(); });
        EXPECT_EQ(alert(), nullptr);
        EXPECT_TRUE(isThere("a.txt"));
        EXPECT_FALSE(isThere(prompt.typed));
    }
}

TEST_F(WaitingChangesTest, AChangeGoesOnWithoutItsPromptAndSaysWhyItFailed)
{
    for (const auto& prompt : prompts()) {
        for (const bool fails : {false, true}) {
            SCOPED_TRACE(std::string(prompt.name) + (fails ? ", fails" : ""));
            confirm(prompt, [&] {
                browser->warpToNewURLPreviewMode(url("other.txt"), PreviewModeQuick);
                EXPECT_EQ(alert(), nullptr);
                if (fails)
                    std::filesystem::remove(url("a.txt").path());
            });
            const bool needsItem = prompt.name != std::string("new folder");
            EXPECT_EQ(isThere(prompt.made), !fails || !needsItem);
            EXPECT_EQ(alert() != nullptr, fails && needsItem);
        }
    }
}

TEST_F(WaitingChangesTest, AnItemThatIsGoneMeanwhileIsSaidInThePrompt)
{
    for (const auto& prompt : prompts()) {
        if (prompt.name == std::string("new folder"))
            continue;
        SCOPED_TRACE(prompt.name);
        confirm(prompt, [this] { std::filesystem::remove(url("a.txt").path()); });
        ASSERT_NE(alert(), nullptr);
        EXPECT_NE(message(), "");
    }
}

TEST_F(WaitingChangesTest, ASignOutEndsADeletionBetweenItsItems)
{
    std::vector<Url> items;
    for (const char* name : {"1.txt", "2.txt", "3.txt"})
        items.push_back(write(name));
    launch();
    post(Notification::ApplicationDidBecomeActive);
    int finished = 0, waits = 0;
    browser->showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
        items, nullptr, topList(), [&] { ++finished; });
    settle();
    coordinator->whileWaiting = [&] {
        if (++waits == 2)
            signOut();
    };
    ASSERT_NE(alert(), nullptr);
    EXPECT_TRUE(alert()->press(0));
    settle();
    EXPECT_FALSE(isThere("1.txt"));
    EXPECT_TRUE(isThere("2.txt") && isThere("3.txt"));
    EXPECT_EQ(waits, 2);
    EXPECT_EQ(finished, 1);
    EXPECT_EQ(alert(), nullptr) << "what was taken back has not failed";
}

TEST_F(WaitingChangesTest, ALongChangeSaysHowFarItIsAndCanBeCancelled)
{
    std::vector<Url> items;
    for (const char* name : {"1.txt", "2.txt", "3.txt"})
        items.push_back(write(name));
    launch();
    const auto atRest = topList()->toolbarItems();
    const auto line = [this] {
        const auto view =
            std::dynamic_pointer_cast<DriveStatusLabelView>(topList()->toolbarItems()[1]->customView());
        return view->primaryLabel()->text();
    };
    std::vector<std::string> lines;
    coordinator->whileWaiting = [&] {
        EXPECT_THAT(dimmed(), testing::ElementsAre("1.txt", "2.txt", "3.txt"));
        dispatch->advance(0.4);
        lines.push_back(line());
        if (lines.size() == 3)
            topList()->toolbarItems().back()->press();
        dispatch->advance(0.2);
        lines.push_back(line());
    };
    browser->moveItemsToDirectoryAndShowErrorsToDirectory(items, url("Documents"));
    settle();
    EXPECT_THAT(
        lines, testing::ElementsAre(testing::StartsWith("5 items"), "0 of 3", "1 of 3", "Cancelling…"));
    EXPECT_EQ(topList()->toolbarItems(), atRest);
    EXPECT_TRUE(isThere("Documents/1.txt") && isThere("2.txt") && isThere("3.txt"));
    EXPECT_EQ(alert(), nullptr);
    EXPECT_THAT(dimmed(), testing::IsEmpty());
}

TEST_F(WaitingChangesTest, ListsThatComeMeanwhileShowTheProgressToo)
{
    const auto a = write("Folder/a.txt"), b = write("Folder/b.txt");
    launch();
    coordinator->whileWaiting = [&] {
        dispatch->advance(1);
        browser->beginEditMode(nullptr);
        EXPECT_EQ(topList()->toolbarItems().size(), 5) << "the buttons of the selection";
        browser->endEditMode(nullptr);
        EXPECT_EQ(topList()->toolbarItems().size(), 4);
        EXPECT_TRUE(browser->warpToFolderForURL(url("Folder/")));
        dispatch->advance(1);
        EXPECT_EQ(topList()->toolbarItems().size(), 4);
        EXPECT_THAT(dimmed(), testing::Contains("b.txt"));
        coordinator->whileWaiting = {};
    };
    browser->moveItemsToDirectoryAndShowErrorsToDirectory({a, b}, url("Documents"));
    settle();
    EXPECT_EQ(topList()->toolbarItems().size(), 3);
    EXPECT_THAT(dimmed(), testing::IsEmpty());
}

/// Something happens between a tap and the question that it leads to, because the disk is slow.
class SlowDiskTest : public BrowserFixture {
protected:
    void perform(DocumentListAction action, const Url& item)
    {
        browser->documentListControllerPerformActionURLOriginatingViewCompletion(
            topList(), static_cast<int>(action), item, topList()->view(), [this] { ++completions; });
    }
    int completions = 0;
};

TEST_F(SlowDiskTest, NoTapLooksAtAnItem)
{
    const auto note = write("a.txt");
    write("Folder/inner.txt");
    struct Row {
        const char* name;
        std::function<void()> tap;
    };
    const Row rows[] = {
        {"folder", [this] { topList()->listView()->activateRow(2); }},
        {"document", [this] { topList()->listView()->activateRow(3); }},
        {"info", [&] { perform(DocumentListAction::Info, note); }},
        {"rename", [&] { perform(DocumentListAction::Rename, note); }},
        {"move", [&] { perform(DocumentListAction::Move, note); }},
        {"delete", [&] { perform(DocumentListAction::Delete, note); }},
        {"select",
            [&] {
                browser->beginEditMode(nullptr);
                topList()->setSelectedItems({note, url("Documents")});
            }},
        {"new folder", [this] { browser->promtForNewFolderAndCreate(nullptr); }},
        {"share", [&] { perform(DocumentListAction::Share, note); }},
        {"peek at a folder", [this] { topList()->listView()->holdRow(2); }},
        {"peek at a document", [this] { topList()->listView()->holdRow(3); }},
        {"pop", [&] { browser->knopPopToURL(note); }},
    };
    // Lines for a person who looks for a fault name the types of folders, which are read.
    platform::setLogLevel(platform::LogLevel::Info);
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        launch();
        ASSERT_EQ(topList()->listView()->row(2).title, "Folder");
        cloud->looksAtItems = 0;
        row.tap();
        EXPECT_EQ(cloud->looksAtItems, 0);
        settle();
    }
}

TEST_F(SlowDiskTest, NoTapInAPreviewLooksAtAnItem)
{
    const auto note = DRItem::initWithURL(write("a.txt"));
    const auto details = [this] {
        return std::dynamic_pointer_cast<PreviewDetailsViewController>(browser->topViewController());
    };
    const auto quick = LookwellItemController::defaultController();
    struct Row {
        const char* name;
        int mode;
        std::function<void()> tap;
        const char* title; ///< of the first action that is then offered; empty: none
    };
    apps->available = {{"Owner", {SimulatedApps::make("editor")}}};
    const Row rows[] = {
        {"details", PreviewModeDetails, [] {}, ""},
        {"share", PreviewModeDetails, [&] { details()->showDocumentActivities(nullptr); },
            "Open in The editor"},
        {"delete", PreviewModeDetails, [&] { details()->showWarningAndDeleteDocument(nullptr); },
            "Delete from Tarrow Drive"},
        {"open", PreviewModeDetails, [&] { details()->openInDefaultApp(); }, ""},
        {"delete in a quick preview", PreviewModeQuick, [&] { quick->showWarningAndDeleteDocument(nullptr); },
            "Delete from Tarrow Drive"},
        {"move in a quick preview", PreviewModeQuick, [&] { quick->showMoveTarget(nullptr); }, ""},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        launch();
        cloud->looksAtItems = 0;
        browser->showPreviewPreviewMode(note, row.mode);
        EXPECT_LE(cloud->looksAtItems, 1) << "the hand-over looks at the name";
        settle();
        cloud->looksAtItems = 0;
        row.tap();
        EXPECT_EQ(cloud->looksAtItems, 0);
        settle();
        EXPECT_EQ(alert() ? alert()->actions().front()->title() : "", row.title);
    }
    EXPECT_THAT(apps->opened, testing::SizeIs(1));
}

TEST_F(SlowDiskTest, APeekThatIsOpenedKeepsItsPreview)
{
    write("a.txt");
    launch();
    topList()->listView()->holdRow(2);
    settle();
    ASSERT_NE(alert(), nullptr);
    ASSERT_EQ(alert()->actions().front()->title(), "Open");
    alert()->press(alert()->actions().front());
    EXPECT_THAT(stack(), testing::SizeIs(1)) << "the disk is slow";
    settle();
    EXPECT_EQ(stack().back(), "*");
    ASSERT_NE(browser->itemManager(), nullptr);
    EXPECT_TRUE(browser->itemManager()->filePresenterRegistered());
}

TEST_F(SlowDiskTest, WhatIsAskedLastCounts)
{
    const auto a = write("a.txt"), b = write("b.txt");
    launch();
    perform(DocumentListAction::Rename, a);
    perform(DocumentListAction::Delete, b);
    EXPECT_EQ(completions, 1) << "the first one is dropped";
    settle();
    ASSERT_NE(alert(), nullptr);
    EXPECT_THAT(alert()->message(), testing::HasSubstr("b.txt"));
    alert()->userCancelled();
    settle();
    EXPECT_EQ(completions, 2);
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(SlowDiskTest, AQuestionDoesNotFollowToAnotherScreen)
{
    const auto note = write("a.txt");
    write("Folder/b.txt");
    const std::function<void()> leaves[] = {
        [this] { browser->warpToNewURLPreviewMode(url("Folder/b.txt"), PreviewModeQuick); },
        [this] { browser->warpToFolderForURL(url("Folder/")); },
        [this] {
            cloud->token = std::nullopt;
            drive.notifications->post(Notification::CloudIdentityDidChange);
        },
    };
    for (const auto& leave : leaves) {
        for (const auto action : {DocumentListAction::Rename, DocumentListAction::Delete,
                 DocumentListAction::Move, DocumentListAction::Info}) {
            cloud->token = platform::PropertyValue("account-1");
            launch();
            post(Notification::ApplicationDidBecomeActive);
            completions = 0;
            perform(action, note);
            leave();
            settle();
            EXPECT_EQ(alert(), nullptr);
            EXPECT_THAT(stack(), testing::Not(testing::Contains("i")));
            EXPECT_EQ(completions, 1) << "the list is told in any case";
        }
    }
}

} // namespace
} // namespace tarrow
