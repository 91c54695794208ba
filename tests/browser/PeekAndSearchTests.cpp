// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"
#include "browser/PeekFolderViewController.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "kit/views/View.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewItemManager.h"
#include "screens/list/DocumentListAction.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using kit::SearchPresentation;
using platform::Url;
using namespace screens;
using testing::ElementsAre;

constexpr auto top = "BrindleDefault";

class PeekAndSearchTest : public BrowserFixture {
protected:
    std::shared_ptr<SearchPresentation> search() const
    {
        return std::dynamic_pointer_cast<SearchPresentation>(browser->presentedViewController());
    }
    /// Answers the alert that lies over everything, be it over a search.
    std::shared_ptr<kit::AlertController> question() const
    {
        return std::dynamic_pointer_cast<kit::AlertController>(browser->visibleViewController());
    }
    std::shared_ptr<kit::ListView> results() const
    {
        return std::dynamic_pointer_cast<kit::ListView>(search()->view()->subviews().front());
    }
    void openSearch()
    {
        topList()->startSearchWithQueryStringBecomeFirstResponder("note", true);
        settle();
        ASSERT_NE(search(), nullptr);
    }
};

TEST_F(PeekAndSearchTest, APeekThatIsLeftTakesItsManagerAlong)
{
    write("Folder/note.txt");
    launch();
    warp("Folder");
    for (const bool isAnswered : {true, false}) {
        ASSERT_TRUE(topList()->listView()->holdRow(0));
        settle();
        const auto manager = browser->itemManager();
        ASSERT_TRUE(alert() && manager && manager->filePresenterRegistered());
        if (isAnswered)
            alert()->userCancelled();
        else
            browser->dismissViewController(false);
        settle();
        EXPECT_EQ(browser->itemManager(), nullptr);
        EXPECT_FALSE(manager->filePresenterRegistered());
        EXPECT_EQ(manager->batonneActivity(), nullptr) << "other devices were offered it";
    }
    ASSERT_TRUE(topList()->listView()->holdRow(0));
    settle();
    alert()->press(alert()->preferredAction());
    settle();
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "*"));
    ASSERT_NE(browser->itemManager(), nullptr);
    EXPECT_TRUE(browser->itemManager()->filePresenterRegistered()) << "the preview is still followed";
}

TEST_F(PeekAndSearchTest, APeekShowsFoldersAndDocuments)
{
    write("Folder/note.txt");
    drive.writeLink("link", "Folder/note.txt");
    launch();
    const auto peek = [this](const char* name) {
        return browser->documentListControllerViewControllerForPreviewingItemAtURL(topList(), url(name));
    };
    const auto folder = std::dynamic_pointer_cast<PeekFolderViewController>(peek("Folder"));
    ASSERT_NE(folder, nullptr);
    EXPECT_EQ(folder->presentedURL(), url("Folder"));
    folder->view();
    EXPECT_FALSE(folder->navigationItem().searchAction());
    EXPECT_TRUE(topList()->navigationItem().searchAction());

    EXPECT_EQ(peek("Folder/note.txt"), LookwellItemController::defaultController());
    EXPECT_EQ(browser->itemManager()->item()->url(), url("Folder/note.txt"));

    for (const char* name : {"gone.txt", "link"}) {
        log->clear();
        EXPECT_EQ(peek(name), nullptr) << name;
        EXPECT_EQ(log->count("DEBUG URL is not a regular file, package, or folder"), 1);
        EXPECT_THAT(log->activities(), ElementsAre("DLC Action Firmtap Peek"));
    }
}

TEST_F(PeekAndSearchTest, APopOpensWhatWasPeekedAt)
{
    write("Folder/Sub/note.txt");
    launch();
    const auto peekAndPop = [this](const char* name) {
        browser->documentListControllerViewControllerForPreviewingItemAtURL(topList(), url(name));
        int completions = 0;
        browser->documentListControllerPerformActionURLOriginatingViewCompletion(topList(),
            static_cast<int>(DocumentListAction::PressurePop), url(name), nullptr, [&] { ++completions; });
        settle();
        EXPECT_EQ(completions, 1);
    };
    peekAndPop("Folder/Sub");
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "Sub"));
    peekAndPop("Folder/Sub/note.txt");
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "Sub", "*"));
    EXPECT_EQ(browser->itemManager()->item()->url(), url("Folder/Sub/note.txt"));

    browser->popToRootViewController(false);
    settle();
    openSearch();
    peekAndPop("Folder/Sub/note.txt");
    EXPECT_EQ(search(), nullptr);
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "Sub", "*"))
        << "what was searched for is shown in its real place";
    ASSERT_NE(browser->itemManager(), nullptr);
    EXPECT_EQ(LookwellItemController::defaultController()->itemManager(), browser->itemManager());
    EXPECT_TRUE(browser->itemManager()->filePresenterRegistered());
}

TEST_F(PeekAndSearchTest, ASearchEndsTheChoiceOfItems)
{
    write("note.txt");
    launch();
    browser->beginEditMode(nullptr);
    browser->startSearch("note");
    EXPECT_FALSE(browser->editMode());
    browser->beginEditMode(nullptr); // while the stack settles
    dispatch->advance(0.8);
    settle();
    ASSERT_NE(search(), nullptr);
    EXPECT_FALSE(browser->editMode() || topList()->editing());
    EXPECT_EQ(topList()->title(), browser->viewTitle());
    results()->activateRow(0);
    settle();
    EXPECT_THAT(stack(), ElementsAre(top, "*"));
}

TEST_F(PeekAndSearchTest, ASearchResultOffersWhatARowOffers)
{
    const auto note = write("Folder/Sub/note.txt");
    launch();
    const auto choose = [&](const char* title) {
        browser->popToRootViewController(false);
        openSearch();
        for (const auto& entry : results()->menuForRow(0)) {
            if (entry.title == title)
                entry.handler();
        }
        settle();
    };
    choose("Rename");
    ASSERT_NE(question(), nullptr);
    question()->textFields().front()->userEdited("note 2.txt", {});
    question()->press(1);
    settle();
    EXPECT_TRUE(std::filesystem::exists(url("Folder/Sub/note 2.txt").path()));
    ASSERT_NE(search(), nullptr) << "the person goes on with the results";
    browser->dismissViewController(false);

    choose("Move");
    EXPECT_NE(std::dynamic_pointer_cast<MoveTargetPicker>(browser->visibleViewController()), nullptr);
    browser->dismissViewController(false);
    choose("Info");
    EXPECT_EQ(search(), nullptr);
    EXPECT_THAT(stack(), ElementsAre(top, "i"));

    browser->popToRootViewController(false);
    openSearch();
    ASSERT_TRUE(results()->holdRow(0));
    settle();
    ASSERT_NE(question(), nullptr);
    std::filesystem::rename(url("Folder/Sub/note 2.txt").path(), url("Folder/else.txt").path());
    dispatch->advance(3);
    settle();
    EXPECT_EQ(question(), nullptr) << "its item is not among the results any more";
    write("Folder/Sub/note 3.txt");
    dispatch->advance(3);
    settle();
    ASSERT_TRUE(results()->holdRow(0));
    settle();
    topList()->refresh();
    settle();
    ASSERT_NE(question(), nullptr) << "the folder below the search has nothing to say about it";
    question()->press(question()->preferredAction());
    settle();
    EXPECT_THAT(stack(), ElementsAre(top, "Folder", "Sub", "*"));
}

} // namespace
} // namespace tarrow
