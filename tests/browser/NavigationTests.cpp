// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/NavController.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "platform/Localization.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewItemManager.h"
#include "prompts/UIUtils.h"
#include "screens/list/DocumentListAction.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using kit::SearchPresentation;
using platform::Url;
using namespace screens;
using testing::ElementsAre;

constexpr auto top = "BrindleDefault";

class NavigationTest : public BrowserFixture {
protected:
    void tapFolder(const Url& folder)
    {
        browser->documentListControllerDidSelectContainerWithViewController(
            topList(), DocumentListController::initWithURL(folder));
        settle();
    }
    void tap(const Url& item)
    {
        browser->documentListControllerDidSelectItemAtURL(topList(), item);
        settle();
    }
    std::shared_ptr<SearchPresentation> search() const
    {
        return std::dynamic_pointer_cast<SearchPresentation>(browser->presentedViewController());
    }
    void openSearch()
    {
        topList()->startSearchWithQueryStringBecomeFirstResponder("note", true);
        settle();
        ASSERT_NE(search(), nullptr);
    }
};

TEST_F(NavigationTest, ADocumentIsPreviewedInTheModeThatFits)
{
    struct Row {
        const char* name;
        int mode;
        const char* screen;
    };
    launch();
    for (const Row row : {Row{"note.txt", PreviewModeQuick, "*"}, {"archive.zip", PreviewModeDetails, "i"}}) {
        write(row.name);
        browser->documentListControllerDidSelectItemAtURL(topList(), url(row.name));
        EXPECT_EQ(browser->itemManager(), nullptr) << "the list ends its handling of the tap first";
        settle();
        EXPECT_THAT(stack(), ElementsAre(top, row.screen));
        ASSERT_NE(browser->itemManager(), nullptr);
        EXPECT_EQ(browser->itemManager()->mode(), row.mode);

        const auto manager = browser->itemManager();
        EXPECT_TRUE(manager->filePresenterRegistered());
        browser->popViewController(false);
        settle();
        EXPECT_EQ(browser->itemManager(), nullptr) << "a folder list is on top again";
        EXPECT_FALSE(manager->filePresenterRegistered());
    }
}

TEST_F(NavigationTest, AVanishedItemIsSaidAndTheBrowserStartsAnew)
{
    write("Folder/a.txt");
    launch();
    tapFolder(url("Folder"));
    const auto before = browser->quotaFetcher();
    browser->documentListControllerDidSelectItemAtURL(topList(), url("Folder/gone.txt"));
    EXPECT_THAT(stack(), ElementsAre(top, "Folder"));
    settle();
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_NE(browser->quotaFetcher(), before);
    ASSERT_NE(alert(), nullptr) << "the message stays until it was read";
    EXPECT_THAT(alert()->title(), testing::HasSubstr("gone.txt"));
    EXPECT_TRUE(alert()->press(0));
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(NavigationTest, LinksAreFollowedOneStepInsideTheDrive)
{
    write("Folder/note.txt");
    write("Folder/archive.zip");
    const auto outside = drive.folder().write("outside.txt", "secret");
    struct Row {
        const char* name;
        std::string target;
        std::vector<std::string> expectedStack;
        const char* log;
        std::string notice{};
    };
    const std::vector<std::string> unmoved{top};
    const Row rows[] = {
        {"document", "Folder/note.txt", {top, "*"}, ""},
        {"folder", "Folder", {top, "Folder"}, "DEBUG Building DLC stack for symlink to "},
        {"outside", outside, unmoved, "DEBUG DLC Selection is symlink to outside target: ",
            "“outside” leads to a place outside the drive."},
        {"dangling", "Folder/nothing", unmoved, "DLC Selection is symlink",
            "“dangling” leads to something that is not there."},
        {"second-step-outside", "outside", unmoved, "DEBUG DLC Selection is symlink to",
            "“second-step-outside” leads to a place outside the drive."},
        {"itself", "itself", {top, "i"}, ""},
    };
    launch();
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        drive.writeLink(row.name, row.target);
        log->clear();
        tap(url(row.name));
        EXPECT_EQ(stack(), row.expectedStack);
        EXPECT_THAT(log->lines(), testing::Contains(testing::HasSubstr(row.log)));
        EXPECT_EQ(takeNotices(), row.notice.empty() ? std::vector<std::string>() : std::vector{row.notice});
        browser->popToRootViewController(false);
        settle();
    }
}

TEST_F(NavigationTest, WarpsReplaceTheStackOrAreRefused)
{
    write("Folder/Sub/note.txt");
    drive.makeFolder("../../documents-evil/Folder");
    std::filesystem::create_directories(drive.layout().trash() + "/Old");
    const auto trashed = Url::fileURL(drive.layout().trash() + "/Old");
    drive.writeLink("way-out", drive.folder().path().string());
    drive.folder().write("secret.txt", "secret");
    struct Row {
        const char* name;
        std::optional<Url> target;
        std::vector<std::string> expectedStack; ///< empty: the jump is refused
    };
    const Row rows[] = {
        {"the top", url(""), {top}},
        {"a folder", url("Folder/Sub"), {top, "Folder", "Sub"}},
        {"a document", url("Folder/Sub/note.txt"), {top, "Folder", "Sub", "*"}},
        {"nothing", std::nullopt, {}},
        {"a missing item", url("Folder/gone.txt"), {}},
        {"below a document", url("Folder/Sub/note.txt/more"), {}},
        {"in the trash", trashed, {}},
        {"outside", Url::fileURL("/etc/passwd"), {}},
        {"a neighbour with the same beginning", url("../../documents-evil/Folder"), {}},
        {"upwards", url("Folder/../../../../secret.txt"), {}},
        {"through a link", url("way-out/secret.txt"), {}},
    };
    launch();
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        UIUtils::showAlertMessageParentViewController("In the way", "", browser);
        const bool warped = browser->warpToNewURLPreviewMode(row.target, PreviewModeQuick);
        settle();
        EXPECT_EQ(warped, !row.expectedStack.empty());
        EXPECT_EQ(stack(), warped ? row.expectedStack : std::vector<std::string>{top});
        EXPECT_EQ(alert(), nullptr) << "what lay over the stack was dismissed";
        browser->popToRootViewController(false);
        settle();
    }
}

TEST_F(NavigationTest, ASearchOpensAtTheTopOnceTheStackHasSettled)
{
    write("Folder/note.txt");
    for (const char* query : {"", "note"}) {
        launch();
        warp("Folder");
        UIUtils::showAlertMessageParentViewController("In the way", "", browser);
        browser->startSearch(query);
        EXPECT_THAT(stack(), ElementsAre(top));
        EXPECT_EQ(alert(), nullptr);
        dispatch->advance(0.6);
        EXPECT_EQ(search(), nullptr);
        dispatch->advance(0.2);
        ASSERT_NE(search(), nullptr);
        EXPECT_EQ(search()->query(), query);
        EXPECT_TRUE(search()->hasFocus());
    }
}

TEST_F(NavigationTest, ARemovedFolderIsLeft)
{
    write("Folder/a.txt");
    launch();
    tapFolder(url("Folder"));
    std::filesystem::remove_all(url("Folder").path());
    topList()->refresh();
    settle();
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_THAT(takeNotices(), ElementsAre("“Folder” is no longer there."));
}

TEST_F(NavigationTest, AnOpenedDocumentIsKeptForTheLauncher)
{
    const auto note = write("note.txt");
    write("Folder/a.txt");
    const auto reference = drive.writeReference("pointer.trwref", "BrindleDefault", "Folder/a.txt");
    launch();
    post(platform::Notification::ApplicationDidBecomeActive);
    const auto peek = [&](const Url& item) {
        browser->documentListControllerViewControllerForPreviewingItemAtURL(topList(), item);
    };
    peek(note);
    browser->documentListControllerPerformActionURL(
        topList(), static_cast<int>(DocumentListAction::Info), note);
    warp("Folder");
    EXPECT_THAT(shortcuts->documents, testing::IsEmpty()) << "no document was opened yet";

    const std::function<void()> ways[] = {[&] { tap(note); }, [&] { warp("note.txt"); },
        [&] { peek(note), browser->knopPopToURL(note); },
        [&] {
            apps->available = {{"Owner", {SimulatedApps::make("editor")}}};
            tap(note);
            EXPECT_THAT(apps->opened, testing::SizeIs(1));
            apps->available.clear();
        }};
    const auto has = [this](std::string_view key) {
        return shortcuts->kept->userInfo.contains(std::string(key));
    };
    for (const auto& way : ways) {
        browser->popToRootViewController(false);
        settle();
        shortcuts->documents.clear();
        way();
        settle();
        EXPECT_THAT(shortcuts->documents, ElementsAre(note));
        EXPECT_TRUE(has(platform::RecentDocumentDocIDKey) && has(platform::RecentDocumentURLKey));
        EXPECT_FALSE(has(platform::RecentDocumentAliasURLKey)) << "an alias would win over the identifier";
    }
    tap(reference);
    EXPECT_THAT(shortcuts->documents, ElementsAre(note, url("Folder/a.txt")));
    EXPECT_TRUE(has(platform::RecentDocumentAliasURLKey));

    tap(note);
    cloud->token = platform::PropertyValue("account-2");
    post(platform::Notification::CloudIdentityDidChange);
    EXPECT_EQ(shortcuts->kept, std::nullopt) << "it was the document of another account";
}

TEST_F(NavigationTest, WhileItemsAreChosenNothingOpens)
{
    write("Folder/a.txt");
    write("note.txt");
    launch();
    tapFolder(url("Folder"));
    browser->popViewController(false);
    settle();
    auto& bar = topList()->navigationItem();
    ASSERT_EQ(bar.rightItems().size(), 1U);
    EXPECT_EQ(bar.rightItems().front()->title(), platform::localized("Select"));
    log->clear();
    EXPECT_TRUE(bar.rightItems().front()->press());
    EXPECT_TRUE(browser->editMode());
    EXPECT_TRUE(topList()->editing());
    EXPECT_TRUE(bar.hidesBackButton());
    EXPECT_EQ(topList()->title(), platform::localized("Select Items"));

    tapFolder(url("Folder"));
    tap(url("note.txt"));
    EXPECT_THAT(stack(), ElementsAre(top));
    EXPECT_EQ(log->count("WARNING DLC Navigation not allowed while in edit mode"), 1);
    EXPECT_EQ(log->count("DEBUG DLC Selection not allowed while in edit mode"), 1);

    browser->selectAllItems(nullptr);
    EXPECT_EQ(topList()->selectedItemCount(), topList()->containedItemCount());
    EXPECT_EQ(topList()->title(),
        platform::localizedPlural(
            ".DICT.ITEMS_SELECTED.%d", {static_cast<std::int64_t>(topList()->containedItemCount())}));
    EXPECT_EQ(
        log->count("DEBUG DLC selected item count is " + std::to_string(topList()->selectedItemCount())), 1);

    EXPECT_TRUE(bar.rightItems().front()->press());
    EXPECT_FALSE(browser->editMode());
    EXPECT_EQ(topList()->selectedItemCount(), 0U);
    EXPECT_NE(topList()->title(), platform::localized("Select Items"));
    EXPECT_THAT(log->activities(),
        testing::IsSupersetOf(
            {"Pressed Select (begin edit)", "Pressed SelectAll", "Pressed Cancel (end edit)"}));
}

TEST_F(NavigationTest, AListThatIsNotEditingEndsEditMode)
{
    write("Folder/a.txt");
    launch();
    tapFolder(url("Folder"));
    topList()->selectAllItems();
    EXPECT_EQ(topList()->selectedItemCount(), 0U);
    topList()->listView()->selectAllByUser(); // the keyboard begins edit mode
    EXPECT_TRUE(browser->editMode());
    EXPECT_EQ(topList()->selectedItemCount(), 1U);
    browser->popViewController(false);
    settle();
    EXPECT_FALSE(browser->editMode());
    EXPECT_EQ(topList()->navigationItem().rightItems().front()->title(), platform::localized("Select"));
}

TEST_F(NavigationTest, ADocumentOpensInTheAppThatOwnsItAndElseInThePreview)
{
    const auto note = write("note.txt");
    write("photo.png");
    drive.writeLink("link", "note.txt");
    launch();
    apps->available = {{"Owner", {SimulatedApps::make("editor")}}};
    const auto opened = SimulatedApps::Opened{note, "editor"};
    tap(note);
    EXPECT_THAT(apps->opened, ElementsAre(opened));
    tap(url("link"));
    tap(drive.writeReference("pointer.trwref", "BrindleDefault", "note.txt"));
    EXPECT_THAT(apps->opened, ElementsAre(opened, opened, opened))
        << "links and references open what they lead to";
    EXPECT_THAT(stack(), ElementsAre(top));

    const auto peekAndPop = [this](const Url& item) {
        browser->documentListControllerViewControllerForPreviewingItemAtURL(topList(), item);
        browser->knopPopToURL(item);
        settle();
    };
    openSearch();
    peekAndPop(note);
    EXPECT_EQ(search(), nullptr);
    EXPECT_THAT(apps->opened, testing::SizeIs(4));
    EXPECT_THAT(stack(), ElementsAre(top));

    apps->appsStart = false;
    peekAndPop(note);
    EXPECT_THAT(stack(), ElementsAre(top, "*"));
    browser->popToRootViewController(false);
    tap(note);
    EXPECT_THAT(stack(), ElementsAre(top, "*"));
    EXPECT_EQ(log->count("DEBUG openInDefaultApp returned YES, app launched"), 4);
    EXPECT_EQ(log->count("DEBUG openInDefaultApp returned NO, showing preview"), 1);
    EXPECT_EQ(log->count("DEBUG openInDefaultApp returned NO, showing cached Lookwell from Knop"), 1);

    apps->appsStart = true;
    browser->popToRootViewController(false);
    tap(url("photo.png"));
    EXPECT_THAT(stack(), ElementsAre(top, "*")) << "pictures are shown here";
}

} // namespace
} // namespace tarrow
