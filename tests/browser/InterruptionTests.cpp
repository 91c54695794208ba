// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/views/Button.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "kit/views/View.h"
#include "preview/PreviewItemManager.h"
#include "prompts/FilenamePrompt.h"
#include "screens/UnavailableScreen.h"
#include "screens/list/DocumentListController.h"
#include "screens/move/MoveTargetPicker.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Notification;
using platform::Url;
using testing::ElementsAre;

/// A person has something open over a folder while something happens elsewhere.
class InterruptionTest : public BrowserFixture {
protected:
    struct Opened {
        const char* name;
        std::function<void()> open;
        /// Answers what is open as the person would who has not noticed anything.
        std::function<void()> answer;
    };
    struct Interruption {
        const char* name;
        std::function<void()> happen;
        bool keepsAccount = true;
    };

    void signInAs(std::optional<platform::PropertyValue> token)
    {
        cloud->token = std::move(token);
        post(Notification::CloudIdentityDidChange);
    }
    void press(std::size_t action) { held->press(action); }
    /// Presents what `open` makes, and keeps it, as the host's widgets do while it moves out.
    void keep()
    {
        held = std::dynamic_pointer_cast<kit::AlertController>(browser->presentedViewController());
    }

    Url note() const { return url("Folder/note.txt"); }
    std::vector<Opened> opened();
    std::vector<Interruption> interruptions();
    void openFolder()
    {
        write("Folder/note.txt", "text");
        write("Other/else.txt");
        launch();
        post(Notification::ApplicationDidBecomeActive);
        ASSERT_TRUE(browser->warpToFolderForURL(url("Folder/")));
        settle();
    }

    std::shared_ptr<kit::AlertController> held;
};

std::vector<InterruptionTest::Opened> InterruptionTest::opened()
{
    const auto renameTo = [this](const char* name) {
        browser->folderPromptAlert()->alert()->textFields().front()->userEdited(name, {0, 0});
        browser->folderPromptAlert()->alert()->press(1);
    };
    return {
        {"peek", [this] { topList()->listView()->holdRow(0); }, [this] { press(0); }},
        {"search", [this] { topList()->startSearchWithQueryStringBecomeFirstResponder("note", true); },
            [] {}},
        {"picker", [this] { browser->showMoveTargetForItemsInFolder({note()}, url("Folder")); },
            [this, picker = std::make_shared<std::shared_ptr<screens::MoveTargetPicker>>()] {
                const auto made = screens::MoveTargetPicker::initWithItemsScope(
                    {note()}, screens::MoveTargetScope::AllContainers);
                browser->documentTargetSelectionControllerDidSelectItemAtURL(made, url("Other"));
            }},
        {"rename", [this] { browser->showRenamePrompt(note()); }, [=] { renameTo("other.txt"); }},
        {"new folder", [this] { browser->promtForNewFolderAndCreate(nullptr); }, [=] { renameTo("Made"); }},
        {"delete",
            [this] {
                browser->showWarningAndDeleteURLsUsingViewWithDocumentListControllerFinishedCompletion(
                    {note()}, nullptr, topList(), {});
            },
            [this] { press(0); }},
        {"share", [this] { browser->showDICUrlCompletion(nullptr, note(), {}); }, [] {}},
    };
}

std::vector<InterruptionTest::Interruption> InterruptionTest::interruptions()
{
    return {
        {"sign-out", [this] { signInAs(std::nullopt); }, false},
        {"another account", [this] { signInAs(platform::PropertyValue("somebody else")); }, false},
        {"URL", [this] { browser->warpToNewURLPreviewMode(url("Other/else.txt"), 0); }},
        {"search shortcut", [this] { browser->startSearch("else"); }},
        {"folder gone",
            [this] {
                std::filesystem::rename(url("Folder").path(), url("Elsewhere").path());
                topList()->refresh();
            }},
    };
}

TEST_F(InterruptionTest, EndsWhateverIsOpenAndNothingOfItIsAnsweredAnyMore)
{
    for (const auto& interruption : interruptions()) {
        for (const auto& thing : opened()) {
            SCOPED_TRACE(std::string(thing.name) + ", " + interruption.name);
            std::filesystem::remove_all(url("Elsewhere").path());
            cloud->token = platform::PropertyValue("account-1");
            openFolder();
            thing.open();
            settle();
            ASSERT_NE(browser->presentedViewController(), nullptr);
            keep();
            interruption.happen();
            settle();
            const auto shown = browser->presentedViewController();
            EXPECT_TRUE(!shown || std::dynamic_pointer_cast<kit::SearchPresentation>(shown));
            EXPECT_THAT(stack(), testing::Not(testing::Contains("Folder")));
            if (interruption.keepsAccount)
                continue;
            thing.answer();
            settle();
            EXPECT_TRUE(FileUtils::exists(note()));
            EXPECT_FALSE(FileUtils::exists(url("Folder/Made")));
            EXPECT_EQ(browser->viewControllers().size(), 1);
            EXPECT_EQ(browser->itemManager(), nullptr);
        }
    }
}

TEST_F(InterruptionTest, AnAnswerThatComesBeforeTheNewsOfASignOutChangesNothing)
{
    for (const auto& thing : opened()) {
        SCOPED_TRACE(thing.name);
        cloud->token = platform::PropertyValue("account-1");
        openFolder();
        thing.open();
        settle();
        keep();
        cloud->token = std::nullopt;
        if (thing.name != std::string("peek"))
            thing.answer();
        settle();
        EXPECT_TRUE(FileUtils::exists(note()));
        EXPECT_FALSE(FileUtils::exists(url("Folder/Made")));
    }
}

TEST_F(InterruptionTest, AQuestionAboutChangesThatWouldBeLostStaysUntilItIsAnswered)
{
    for (const auto& interruption : interruptions()) {
        SCOPED_TRACE(interruption.name);
        std::filesystem::remove_all(url("Elsewhere").path());
        cloud->token = platform::PropertyValue("account-1");
        openFolder();
        const auto question = std::make_shared<kit::AlertController>("Unsaved", "", kit::AlertStyle::Alert);
        for (const char* answer : {"Keep a Copy", "Discard Changes"})
            question->addAction(std::make_shared<kit::AlertAction>(answer, kit::AlertActionStyle::Default));
        browser->presentViewController(question, false);
        interruption.happen();
        settle();
        EXPECT_EQ(alert(), question);
    }
}

TEST_F(InterruptionTest, APeekEndsWithItsItem)
{
    openFolder();
    ASSERT_TRUE(topList()->listView()->holdRow(0));
    settle();
    ASSERT_NE(alert(), nullptr);
    std::filesystem::remove(note().path());
    topList()->refresh();
    settle();
    EXPECT_EQ(alert(), nullptr);
    EXPECT_THAT(takeNotices(), ElementsAre("“note.txt” is no longer there."));
}

TEST_F(InterruptionTest, ASignOutEndsTheChoiceOfItems)
{
    openFolder();
    browser->beginEditMode(nullptr);
    signInAs(std::nullopt);
    EXPECT_FALSE(browser->editMode());
    signInAs(platform::PropertyValue("account-1"));
    EXPECT_FALSE(topList()->editing());
    EXPECT_EQ(topList()->title(), browser->viewTitle());
    EXPECT_NE(topList()->title(), "Select Items");
}

TEST_F(InterruptionTest, ADriveWithoutItsFolderIsTriedAgain)
{
    const auto home = std::filesystem::path(url("").path());
    const auto away = home.parent_path().parent_path() / "away";
    std::filesystem::rename(home, away);
    launch();
    const auto screen = std::dynamic_pointer_cast<screens::UnavailableScreen>(browser->topViewController());
    ASSERT_NE(screen, nullptr);
    screen->view();
    const auto& buttons = screen->placeholder()->buttons();
    ASSERT_EQ(buttons.size(), 1);
    std::filesystem::rename(away, home);
    buttons.front()->press();
    settle();
    EXPECT_NE(topList(), nullptr);
}

} // namespace
} // namespace tarrow
