// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/BarButtonItem.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "kit/views/View.h"
#include "preview/PreviewItemManager.h"
#include "prompts/FilenamePrompt.h"
#include "prompts/SimpleTextViewController.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentListAction.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"
#include "tests/browser/support/BrowserFixture.h"

#include <set>

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Url;
using screens::DocumentListAction;
using testing::ElementsAre;

class ItemActionsTest : public BrowserFixture {
protected:
    void perform(DocumentListAction action, const Url& item) { perform(static_cast<int>(action), item); }
    void perform(int action, const Url& item)
    {
        browser->documentListControllerPerformActionURLOriginatingViewCompletion(
            topList(), action, item, topList()->view(), [this] { ++completions; });
        settle();
    }
    /// Types a name into the prompt on the screen and confirms it. Answers the message that the prompt then
    /// shows.
    std::string enter(const std::string& name)
    {
        const auto prompt = browser->folderPromptAlert();
        prompt->alert()->textFields().front()->userEdited(name, {name.size(), 0});
        prompt->alert()->press(1);
        settle();
        return prompt->errMsgViewController()->messageLabel()->text();
    }
    void remove(const std::vector<Url>& items)
    {
        browser->showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
            items, nullptr, topList(), [this] { ++completions; });
        settle();
    }
    bool isThere(std::string_view path) const { return std::filesystem::exists(url(path).path()); }

    int completions = 0;
};

TEST_F(ItemActionsTest, ItemsFollowIntoTheFolderThatIsMadeForThem)
{
    const auto a = write("a.txt"), b = write("b.txt");
    launch();
    browser->showNewFolderPromptDuringMoveItemsToMove(topList()->presentedURL(), {a, b});
    EXPECT_EQ(alert()->title(), "Move 2 Items");
    EXPECT_EQ(alert()->actions()[1]->title(), "Move");
    EXPECT_EQ(enter("Desktop"), "Name is already taken");
    EXPECT_EQ(enter("  Both "), "");
    EXPECT_EQ(alert(), nullptr);
    EXPECT_TRUE(isThere("Both/a.txt") && isThere("Both/b.txt"));

    const auto c = write("c.txt");
    browser->showNewFolderPromptDuringMoveItemsToMove(
        topList()->presentedURL(), {url("gone.txt"), c, url("lost.txt")});
    EXPECT_EQ(enter("Some"), "2 items couldn’t be moved.");
    EXPECT_NE(alert(), nullptr) << "it stays over the new folder";
    EXPECT_TRUE(isThere("Some/c.txt")) << "a failure does not stop the others";
}

TEST_F(ItemActionsTest, AMenuLeavesOutWhatWouldBeRefused)
{
    write("a.txt");
    launch();
    const auto titles = [&](std::size_t row) {
        std::set<std::string> all;
        for (const auto& entry : topList()->listView()->menuForRow(row))
            all.insert(entry.title);
        return all;
    };
    const auto items = topList()->containedItems();
    for (std::size_t row = 0; row < items.size(); ++row) {
        const bool isSpecial = items[row].lastPathComponent() != "a.txt";
        for (const char* title : {"Rename", "Move", "Delete", "Move to Trash"})
            EXPECT_EQ(titles(row).contains(title), !isSpecial) << title << " of " << items[row].path();
        EXPECT_TRUE(titles(row).contains("Info"));
    }
    EXPECT_EQ(items.size(), 3U);
    browser->beginEditMode(nullptr);
    for (const bool isSpecial : {true, false}) {
        topList()->setSelectedItems({url("a.txt"), isSpecial ? url("Desktop") : url("a.txt")});
        const auto menu = topList()->listView()->menuForList();
        EXPECT_EQ(std::ranges::count(menu, "Move to Trash", &kit::MenuAction::title), isSpecial ? 0 : 1);
    }
}

TEST_F(ItemActionsTest, AFolderIsMadeFromTheMenuAndFromAnEmptyFolder)
{
    const auto folder = drive.makeFolder("Empty");
    launch();
    ASSERT_TRUE(warp("Empty"));
    const auto list = topList();
    ASSERT_EQ(list->placeholder()->buttons().size(), 2U);
    list->placeholder()->buttons().front()->press();
    EXPECT_EQ(enter("One"), "");
    EXPECT_TRUE(isThere("Empty/One"));
    list->refresh();
    settle();
    EXPECT_TRUE(list->placeholder()->isHidden());
    const auto menu = list->listView()->menuForList();
    ASSERT_EQ(menu.front().title, "New Folder");
    menu.front().handler();
    EXPECT_EQ(enter("Two"), "");
    EXPECT_TRUE(isThere("Empty/Two"));
}

TEST_F(ItemActionsTest, APreviewsMenuActsOnItsDocument)
{
    write("a.txt");
    launch();
    const auto choose = [&](const std::string& title) {
        ASSERT_TRUE(warp("a.txt"));
        for (const auto& entry : browser->topViewController()->navigationItem().menu()()) {
            if (entry.title == title)
                entry.handler();
        }
        settle();
    };
    choose("Share");
    EXPECT_NE(browser->topViewController()->presentedViewController(), nullptr);
    choose("Info");
    EXPECT_THAT(stack(), ElementsAre("BrindleDefault", "i"));
    choose("Rename");
    EXPECT_EQ(enter("b.txt"), "");
    EXPECT_TRUE(isThere("b.txt"));
    write("a.txt");
    choose("Move to Trash");
    EXPECT_FALSE(isThere("a.txt"));
    EXPECT_THAT(stack(), ElementsAre("BrindleDefault"));
}

TEST_F(ItemActionsTest, SpecialFoldersStayAsTheyAre)
{
    const auto other = write("other.txt");
    launch();
    for (const char* name : {"Desktop", "Documents"}) {
        perform(DocumentListAction::Rename, url(name));
        EXPECT_EQ(takeAlert(), "This operation is not supported.");
        perform(DocumentListAction::Delete, url(name));
        EXPECT_EQ(takeAlert(), "This operation is not supported.");
        remove({other, url(name)});
        EXPECT_EQ(takeAlert(), "This operation is not supported.");
        EXPECT_TRUE(isThere(name));
    }
    EXPECT_TRUE(isThere("other.txt"));
    EXPECT_EQ(completions, 6);
    EXPECT_EQ(log->count("WARNING Not renaming special folder: " + logText(url("Desktop"))), 1);
}

TEST_F(ItemActionsTest, ADeletionEndsWithTheAnswer)
{
    const auto budget = write("Budget.txt");
    launch();
    perform(DocumentListAction::Delete, budget);
    ASSERT_NE(alert(), nullptr);
    EXPECT_THAT(alert()->message(), testing::StartsWith("\"Budget.txt\" will be permanently deleted"));
    EXPECT_EQ(completions, 0);
    alert()->userCancelled();
    EXPECT_EQ(completions, 1);
    EXPECT_TRUE(isThere("Budget.txt"));

    perform(DocumentListAction::Delete, budget);
    EXPECT_TRUE(alert()->press(0));
    EXPECT_EQ(completions, 1) << "the deletion has not ended";
    EXPECT_TRUE(isThere("Budget.txt"));
    settle();
    EXPECT_EQ(completions, 2);
    EXPECT_FALSE(isThere("Budget.txt"));
    EXPECT_THAT(takeNotices(), ElementsAre("“Budget.txt” was deleted"));
    remove({write("a.txt"), write("b.txt")});
    EXPECT_TRUE(alert()->press(0));
    settle();
    EXPECT_THAT(takeNotices(), ElementsAre("2 items were deleted"));
}

TEST_F(ItemActionsTest, FailedDeletionsAreCounted)
{
    launch();
    const auto gone = write("gone.txt"), lost = write("lost.txt"), kept = write("kept.txt");
    remove({gone, kept});
    std::filesystem::remove(gone.path());
    ASSERT_NE(alert(), nullptr);
    EXPECT_TRUE(alert()->press(0));
    settle();
    EXPECT_NE(takeAlert(), "") << "the one error is shown";
    EXPECT_FALSE(isThere("kept.txt"));

    write("kept.txt");
    remove({gone, kept, lost});
    std::filesystem::remove(lost.path());
    EXPECT_TRUE(alert()->press(0));
    settle();
    EXPECT_EQ(takeAlert(), "2 items couldn’t be deleted.");
    EXPECT_FALSE(isThere("kept.txt")) << "a failure does not stop the others";
    EXPECT_EQ(completions, 2);
}

TEST_F(ItemActionsTest, AppLibrariesAreDeletedWholeButNeverTheDrive)
{
    const auto recipes = drive.makeContainer("app.recipes");
    std::filesystem::create_directories(recipes.appendingPathComponent("Soups").path());
    const auto document = write("a.txt");
    launch();
    remove({recipes, document});
    EXPECT_EQ(alert(), nullptr);
    EXPECT_EQ(log->count("ERROR Not Deleting: mix of containers and items: "
                  + logText(std::vector<Url>{recipes, document})),
        1);

    remove({recipes, *topList()->presentedURL()});
    ASSERT_NE(alert(), nullptr);
    EXPECT_TRUE(alert()->press(0));
    settle();
    EXPECT_FALSE(std::filesystem::exists(recipes.path()));
    EXPECT_TRUE(isThere("a.txt"));
    EXPECT_EQ(takeAlert(), "Mishap exception");
    EXPECT_EQ(log->count("INFO Deleting container app.recipes"), 1);
    EXPECT_EQ(log->count("ERROR NOT Deleting root container BrindleDefault"), 1);
    EXPECT_EQ(completions, 2);
}

TEST_F(ItemActionsTest, EditModeOffersItsButtonsByTheSelection)
{
    const auto a = write("a.txt"), b = write("Folder/b.txt");
    launch();
    const auto titles = [this] {
        std::vector<std::string> found;
        for (const auto& item : topList()->toolbarItems()) {
            const auto button = std::dynamic_pointer_cast<kit::Button>(item->customView());
            found.push_back(button ? button->title() : item->isSpace() ? "-" : "status");
        }
        return found;
    };
    browser->beginEditMode(nullptr);
    EXPECT_THAT(titles(), ElementsAre("New Folder", "-", "Move", "-", "Delete"));
    EXPECT_TRUE(browser->barButtonNewFolder()->isEnabled());
    struct Row {
        std::vector<Url> selected;
        bool isOffered;
    };
    for (const auto& row :
        {Row{{}, false}, {{a}, true}, {{a, url("Folder")}, true}, {{a, url("Desktop")}, false}}) {
        topList()->setSelectedItems(row.selected);
        EXPECT_EQ(browser->barButtonMoveItem()->isEnabled(), row.isOffered) << row.selected.size();
        EXPECT_EQ(browser->barButtonDeleteItem()->isEnabled(), row.isOffered) << row.selected.size();
    }
    topList()->setSelectedItems({a});
    const auto press = [](const std::shared_ptr<kit::BarButtonItem>& item) {
        std::dynamic_pointer_cast<kit::Button>(item->customView())->press();
    };
    press(browser->barButtonNewFolder());
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->message(), "Enter a name for this folder.");
    EXPECT_EQ(alert()->textFields().front()->placeholder(), "Folder Name");
    EXPECT_EQ(alert()->actions()[1]->title(), "Create");
    EXPECT_EQ(takeAlert(), "New Folder");
    press(browser->barButtonDeleteItem());
    settle();
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(std::get<std::weak_ptr<kit::BarButtonItem>>(alert()->popoverAnchor()).lock(),
        browser->barButtonDeleteItem());
    alert()->userCancelled();
    EXPECT_TRUE(browser->editMode()) << "nothing happened";
    press(browser->barButtonDeleteItem());
    settle();
    alert()->press(0);
    settle();
    EXPECT_FALSE(isThere("a.txt"));
    EXPECT_FALSE(browser->editMode());
    EXPECT_THAT(titles(), ElementsAre("-", "status", "-"));
    EXPECT_EQ(browser->barButtonDeleteItem(), nullptr);
    EXPECT_EQ(log->count("INFO Pressed Delete after selecting 1 items: " + logText(std::vector<Url>{a})), 2);
}

TEST_F(ItemActionsTest, ItemsMoveToTheFolderThatIsChosen)
{
    const auto a = write("a.txt"), b = write("b.txt");
    write("Folder/b.txt");
    launch();
    browser->beginEditMode(nullptr);
    topList()->setSelectedItems({a, b});
    browser->showMoveTargetForSelectedItems(nullptr);
    EXPECT_FALSE(browser->editMode());
    settle();
    const auto picker =
        std::dynamic_pointer_cast<screens::MoveTargetPicker>(browser->presentedViewController());
    ASSERT_NE(picker, nullptr);
    EXPECT_THAT(picker->itemsToMove(), ElementsAre(a, b));
    EXPECT_EQ(picker->presentationStyle(), kit::PresentationStyle::OverCurrentContext);
    EXPECT_EQ(log->count("INFO Prompting for Move Target, 2 items"), 1);
    browser->documentTargetSelectionControllerDidSelectItemAtURL(picker, url("Folder"));
    EXPECT_FALSE(isThere("Folder/a.txt")) << "the items move after the tap";
    settle();
    EXPECT_TRUE(isThere("Folder/a.txt"));
    EXPECT_TRUE(isThere("b.txt")) << "nothing is replaced";
    EXPECT_EQ(takeAlert(), "An item named “b.txt” already exists in the new location.");
    EXPECT_EQ(browser->presentedViewController(), nullptr);
    browser->moveItemsToDirectoryAndShowErrorsToDirectory({url("x"), url("y")}, url("Folder"));
    settle();
    EXPECT_EQ(takeAlert(), "2 items couldn’t be moved.");

    perform(DocumentListAction::Move, url("Desktop"));
    EXPECT_EQ(takeAlert(), "This operation is not supported.");
}

TEST_F(ItemActionsTest, WithoutAnyFolderAMoveMakesOne)
{
    const auto documents = drive.makeContainer("app.notes");
    const auto note = documents.appendingPathComponent("note.txt");
    std::filesystem::copy_file(write("note.txt").path(), note.path());
    launch();
    // With one container there is no other folder to move to.
    std::filesystem::remove_all(drive.layout().defaultContainer());
    browser->showMoveTargetForItemsInFolder({note}, documents);
    settle();
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->title(), "Move 1 Item");
    EXPECT_EQ(enter("Notes"), "");
    EXPECT_TRUE(std::filesystem::exists(documents.path() + "/Notes/note.txt"));
}

TEST_F(ItemActionsTest, TheShareSheetPointsAtTheMiddleOfItsView)
{
    const auto target = write("Folder/a.txt");
    drive.writeReference("a.txt.trwref", "BrindleDefault", "Folder/a.txt");
    const auto recipes = drive.makeContainer("app.recipes");
    launch();
    const auto view = std::make_shared<kit::View>(platform::Rect{0, 0, 300, 60});
    browser->showDICUrlCompletion(view, url("a.txt.trwref"), {});
    settle();
    EXPECT_EQ(browser->documentInteractionController()->url(), target);
    EXPECT_EQ(log->count("INFO URL resolved to " + logText(target)), 1);
    ASSERT_NE(alert(), nullptr);
    const auto* place = std::get_if<kit::ViewAnchor>(&alert()->popoverAnchor());
    ASSERT_NE(place, nullptr);
    EXPECT_EQ(place->view.lock(), view);
    EXPECT_EQ(place->rect, (platform::Rect{0, 30, 300, 0}));
    alert()->userCancelled();
    settle();

    perform(DocumentListAction::Share, recipes);
    EXPECT_EQ(completions, 1) << "the list need not wait for the sheet";
    settle();
    EXPECT_EQ(browser->documentInteractionController()->name(), "app.recipes");
}

TEST_F(ItemActionsTest, InfoShowsTheDetailsOfItsItem)
{
    const auto note = write("a.txt"), folder = url("Documents");
    launch();
    for (const auto& item : {note, folder}) {
        perform(DocumentListAction::Info, item);
        EXPECT_THAT(stack(), ElementsAre("BrindleDefault", "i"));
        ASSERT_NE(browser->itemManager(), nullptr);
        EXPECT_EQ(browser->itemManager()->item()->url(), item);
        EXPECT_EQ(browser->itemManager()->mode(), PreviewModeDetails);
        EXPECT_EQ(log->count("INFO Info action: " + logText(item)), 1);
        browser->popViewController(false);
        settle();
    }
    EXPECT_EQ(completions, 2);
    perform(DocumentListAction::Info, url("gone.txt"));
    EXPECT_EQ(stack().size(), 1);
    EXPECT_EQ(completions, 3) << "the list is told in any case";
}

TEST_F(ItemActionsTest, WhatCannotBePerformedEndsAtOnce)
{
    write("a.txt");
    launch();
    perform(7, url("a.txt"));
    perform(DocumentListAction::Rename, url("gone.txt"));
    EXPECT_EQ(alert(), nullptr);
    EXPECT_EQ(completions, 2);
}

} // namespace
} // namespace tarrow
