// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "PreviewFixture.h"
#include "items/FileUtils.h"
#include "kit/views/Label.h"
#include "platform/ActivityHandOver.h"
#include "preview/FileInfoStackView.h"
#include "screens/PlaceholderView.h"
#include "screens/preview/PreviewContent.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <thread>

using namespace platform;
using namespace tarrow;
using screens::MoveTargetPicker;
using namespace testing;

namespace {

/// Other programs and the preview's own buttons change the previewed document.
class Presenter : public testing_support::PreviewFixture {
protected:
    /// Previews a document and runs everything that follows.
    Url open(const char* name, int mode = PreviewModeQuick)
    {
        const auto item = document(name);
        manager->setMode(mode);
        manager->previewItem(item);
        drive.settle();
        return item->url();
    }
    /// Saves a document as another program does, `seconds` after its last change.
    void save(const Url& url, const std::string& content, int seconds) const
    {
        static_cast<void>(
            drive.fileCoordinator->coordinateWriting(url, WritingOptions::None, [&](const Url& place) {
                struct stat before { };
                ::stat(place.path().c_str(), &before);
                std::ofstream(place.path(), std::ios::trunc) << content;
                const timespec times[] = {
                    before.st_atim, {before.st_mtim.tv_sec + seconds, before.st_mtim.tv_nsec}};
                ::utimensat(AT_FDCWD, place.path().c_str(), times, 0);
            }));
        drive.settle();
    }
    auto refreshes() const
    {
        return std::ranges::count_if(
            drive.log->lines(), [](const auto& line) { return line.starts_with("INFO Refreshing "); });
    }
    std::string top() const { return Url::fileURL(drive.layout().defaultContainer()).lastPathComponent(); }
    static constexpr auto reloaded = "DEBUG LWPreviewController: refreshCurrentPreviewItem";
};

TEST_F(Presenter, ReadsOnceForAllChangesOfASecond)
{
    const auto url = open("Notes.txt");
    save(url, "first", 10);
    drive.dispatch->advance(0.3);
    save(url, "second", 10);
    EXPECT_TRUE(manager->refreshPending());
    drive.dispatch->advance(0.6);
    EXPECT_EQ(refreshes(), 0);
    drive.dispatch->advance(0.2);
    EXPECT_EQ(refreshes(), 1);
    EXPECT_FALSE(manager->refreshPending());
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(preview->content()->text, "second");

    save(url, "third", 10);
    drive.dispatch->advance(1.1);
    EXPECT_EQ(refreshes(), 2) << "the next change counts anew";
}

TEST_F(Presenter, ReloadsOnlyNewerContentThatSomebodySees)
{
    const auto url = open("Notes.txt");
    const auto change = [&](int seconds) {
        drive.log->clear();
        preview->setTitle("Old");
        save(url, "changed", seconds);
        drive.dispatch->advance(1.1);
    };
    change(0);
    EXPECT_EQ(preview->title(), "Notes.txt");
    EXPECT_EQ(drive.log->count(reloaded), 0U) << "the content is as old as it was";
    change(10);
    EXPECT_EQ(drive.log->count(reloaded), 1U);
    change(-20);
    EXPECT_EQ(drive.log->count(reloaded), 0U) << "an older version came back";
    navigation->popViewController(false);
    change(40);
    EXPECT_EQ(drive.log->count(reloaded), 0U) << "nobody sees it";
    EXPECT_EQ(refreshes(), 1);
}

TEST_F(Presenter, ShowsTheNameInSafeCharactersAfterARefreshToo)
{
    const auto url = open("Bill\n\u202Efdp\u202C.exe");
    const auto before = preview->title();
    EXPECT_THAT(before, testing::Not(HasSubstr("\n")));
    manager->refreshItem(url);
    EXPECT_EQ(preview->title(), before);
}

TEST_F(Presenter, BringsTheDetailsUpToDate)
{
    const auto url = open("Notes.txt", PreviewModeDetails);
    EXPECT_THAT(stack(), ElementsAre("-", "i"));
    const auto details = manager->detailsViewController();
    ASSERT_TRUE(details);
    const auto size = [&] {
        const auto& rows = details->fileInfoView()->arrangedSubviews();
        return std::static_pointer_cast<FileInfoCell>(rows.at(1))->valueLabel()->text();
    };
    const auto before = size();
    save(url, std::string(5000, 'x'), 10);
    drive.dispatch->advance(1.1);
    EXPECT_NE(size(), before);

    manager->previewItem(DRItem::initWithURL(url));
    EXPECT_NE(manager->detailsViewController(), details) << "each preview has a screen of its own";
    EXPECT_EQ(navigation->topViewController(), manager->detailsViewController());
    navigation->popViewController(false);
    EXPECT_FALSE(manager->detailsViewController());
}

TEST_F(Presenter, SaysThatAnItemIsElsewhereThoughNobodyMovedIt)
{
    open("Notes.txt");
    const auto other = document("Other.txt")->url();
    manager->refreshItem(other);
    EXPECT_EQ(manager->item()->url(), other);
    EXPECT_THAT(drive.log->lines(), testing::Contains(HasSubstr("ERROR UNEXPECTED: path changed")));
    EXPECT_THAT(stack(), ElementsAre("-", "*"));
    manager->refreshItem(drive.url("Gone.txt"));
    EXPECT_EQ(manager->item()->url(), other) << "what cannot be read changes nothing";
}

TEST_F(Presenter, FollowsTheFolderThatItsDocumentLiesIn)
{
    open("Documents/Trip/Plan.txt");
    EXPECT_FALSE(FileUtils::moveTo(drive.url("Documents/Trip"), drive.url("Desktop/Tour")));
    drive.settle();
    EXPECT_THAT(stack(), ElementsAre(top(), "Desktop", "Tour", "*"));
    EXPECT_TRUE(manager->filePresenterRegistered());

    const auto target = drive.url("Desktop/Tour/Plan.txt");
    const auto screens = navigation->viewControllers();
    manager->presentedItemDidMoveToURL(target);
    drive.settle();
    EXPECT_EQ(drive.log->count(
                  "WARNING UNEXPECTED: duplicate calls to presentedItemDidMoveToURL: " + target.path()),
        1U);
    EXPECT_EQ(navigation->viewControllers(), screens);
}

TEST_F(Presenter, ClosesForAnItemThatLeavesTheDrive)
{
    for (const auto& place : {drive.layout().trash() + "/Notes.txt", drive.folder().at("elsewhere.txt")}) {
        open("Notes.txt");
        EXPECT_THAT(stack(), ElementsAre("-", "*"));
        manager->presentedItemDidMoveToURL(Url::fileURL(place));
        EXPECT_FALSE(manager->filePresenterRegistered());
        drive.settle();
        EXPECT_THAT(stack(), ElementsAre("-")) << place;
    }
}

TEST_F(Presenter, TakesNoOtherScreenAway)
{
    const auto prepared = document("Notes.txt");
    const auto below = std::make_shared<kit::ViewController>();
    navigation->pushViewController(below, false);
    manager->prepareToPreviewItem(prepared);
    drive.settle();
    EXPECT_FALSE(FileUtils::remove(prepared->url()));
    drive.settle();
    EXPECT_THAT(stack(), ElementsAre("-", "-")) << "a peek's document has no screen on the stack";
}

TEST_F(Presenter, LooksAgainWhenPartOfThePackageGoes)
{
    const auto url = open("Notes.txt");
    int answers = 0;
    manager->accommodatePresentedSubitemDeletionAtURLCompletionHandler(
        url.appendingPathComponent("part"), [&](const auto& error) {
            EXPECT_FALSE(error);
            ++answers;
        });
    EXPECT_EQ(answers, 1) << "the writer does not wait";
    drive.dispatch->advance(0.9);
    EXPECT_EQ(drive.log->count(reloaded), 0U);
    drive.dispatch->advance(0.2);
    EXPECT_EQ(drive.log->count(reloaded), 1U);
    EXPECT_FALSE(manager->filePresenterRegistered());
}

TEST_F(Presenter, DoesNothingOnceItIsGone)
{
    const auto url = open("Notes.txt");
    manager->presentedItemDidChange();
    manager->presentedItemDidMoveToURL(drive.url("Documents"));
    manager->accommodatePresentedSubitemDeletionAtURLCompletionHandler(url, [](const auto&) {});
    drive.log->clear();
    manager = nullptr;
    drive.settle();
    drive.dispatch->advance(2);
    EXPECT_EQ(refreshes(), 0);
    EXPECT_THAT(stack(), ElementsAre("-", "*"));
}

TEST_F(Presenter, EndsOnTheMainThreadWhoeverLetsGoLast)
{
    open("Notes.txt");
    const std::weak_ptr handedOver = manager->batonneActivity();
    std::thread([last = std::move(manager)]() mutable { last = nullptr; }).join();
    EXPECT_FALSE(handedOver.expired()) << "not on the other thread";
    drive.settle();
    EXPECT_TRUE(handedOver.expired());
}

TEST_F(Presenter, HandsTheDocumentOverWhileItIsWatched)
{
    const auto url = open("Notes.txt");
    const auto activity = manager->batonneActivity();
    ASSERT_TRUE(activity);
    EXPECT_EQ(activity->type, "BrindleDocsID.viewing");
    const std::filesystem::path published(drive.layout().activities());
    EXPECT_FALSE(std::filesystem::is_empty(published));

    drive.notifications->post(Notification::ApplicationWillResignActive);
    EXPECT_FALSE(manager->batonneActivity());
    EXPECT_FALSE(manager->filePresenterRegistered());
    drive.settle();
    EXPECT_TRUE(std::filesystem::is_empty(published));
    drive.notifications->post(Notification::ApplicationDidBecomeActive);
    drive.settle();
    EXPECT_FALSE(std::filesystem::is_empty(published));

    manager->prepareToPreviewItem(DRItem::initWithURL(url));
    EXPECT_TRUE(manager->batonneActivity()) << "the same item stays watched";
    manager->prepareToPreviewItem(document("Other.txt"));
    EXPECT_FALSE(manager->batonneActivity());
    manager->unregisterAsFilePresenter();
    drive.settle();
    EXPECT_FALSE(manager->batonneActivity()) << "a bookmark that came too late";
    EXPECT_TRUE(std::filesystem::is_empty(published));
}

TEST_F(Presenter, LooksAgainWhenTheWindowIsNoLongerMinimised)
{
    const auto url = open("Notes.txt");
    drive.notifications->post(Notification::ApplicationDidLoseFocus);
    EXPECT_TRUE(manager->filePresenterRegistered()) << "it may stand beside another window";
    drive.notifications->post(Notification::ApplicationDidBecomeActive);
    EXPECT_EQ(refreshes(), 0) << "whoever follows need not look";

    drive.notifications->post(Notification::ApplicationWillResignActive);
    save(url, "changed meanwhile", 10);
    drive.notifications->post(Notification::ApplicationDidBecomeActive);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(preview->content()->text, "changed meanwhile");

    drive.notifications->post(Notification::ApplicationWillResignActive);
    std::filesystem::remove(url.path());
    drive.settle();
    EXPECT_THAT(stack(), ElementsAre("-", "*"));
    drive.notifications->post(Notification::ApplicationDidBecomeActive);
    EXPECT_THAT(stack(), ElementsAre("-"));
    EXPECT_FALSE(manager->filePresenterRegistered());
}

TEST_F(Presenter, HandsOverNothingThatOthersCannotOpen)
{
    const auto outside = Url::fileURL(drive.folder().write("outside.txt", "text"));
    manager->previewItem(DRItem::initWithURL(outside));
    drive.settle();
    EXPECT_FALSE(manager->batonneActivity());
    EXPECT_THAT(drive.log->lines(),
        testing::Contains(HasSubstr("INFO RZBookmarkableStringFromDocumentURL returned ")));
}

TEST_F(Presenter, DeletesWhenTheUserConfirms)
{
    const auto url = open("Notes.txt");
    const auto press = [&](std::size_t action) {
        preview->additionalRightBarButtonItems().front()->press();
        drive.settle();
        ASSERT_TRUE(alert());
        EXPECT_THAT(alert()->message(), HasSubstr("Notes.txt"));
        EXPECT_TRUE(alert()->press(action));
        drive.settle();
    };
    press(1);
    EXPECT_THAT(stack(), ElementsAre("-", "*"));
    press(0);
    EXPECT_THAT(stack(), ElementsAre("-"));
    EXPECT_FALSE(alert());
    EXPECT_FALSE(std::filesystem::exists(url.path()));
    EXPECT_FALSE(manager->filePresenterRegistered());
    EXPECT_FALSE(manager->batonneActivity());
    EXPECT_THAT(drive.log->activities(),
        testing::IsSupersetOf(
            {"Pressed Delete (LW)", "Delete was Cancelled (itemMgr)", "Delete was Confirmed (itemMgr)"}));
}

TEST_F(Presenter, SaysWhyADocumentCouldNotBeDeletedOrMovedAlsoWhenThePreviewWasLeft)
{
    const auto folder = drive.makeFolder("Documents/Trip");
    for (const bool isMoved : {false, true}) {
        for (const bool isLeft : {false, true}) {
            manager = PreviewItemManager::newItemManagerWithModeNavController(PreviewModeQuick, navigation);
            const auto url = open("Notes.txt");
            const auto& buttons = preview->additionalRightBarButtonItems();
            (isMoved ? buttons.back() : buttons.front())->press();
            drive.settle();
            manager->unregisterAsFilePresenter();
            std::filesystem::remove(url.path());
            if (isMoved)
                std::dynamic_pointer_cast<MoveTargetPicker>(navigation->presentedViewController())
                    ->choose(folder);
            else
                alert()->press(0);
            // The browser lets go of the manager as soon as the list is shown.
            if (isLeft) {
                navigation->popViewController(false);
                manager = nullptr;
            }
            drive.settle();
            ASSERT_TRUE(alert()) << isMoved << isLeft;
            EXPECT_EQ(alert()->actions().size(), 1U);
            EXPECT_FALSE(alert()->title().empty());
            EXPECT_TRUE(alert()->press(0));
        }
    }
}

TEST_F(Presenter, MovesToTheChosenFolder)
{
    const auto url = open("Notes.txt");
    const auto folder = drive.makeFolder("Documents/Trip");
    const auto choose = [&] {
        preview->additionalRightBarButtonItems().back()->press();
        drive.settle();
        const auto picker =
            std::dynamic_pointer_cast<MoveTargetPicker>(navigation->presentedViewController());
        ASSERT_TRUE(picker);
        EXPECT_EQ(picker->presentationStyle(), kit::PresentationStyle::OverCurrentContext);
        EXPECT_EQ(picker->itemsToMove(), std::vector{manager->item()->url()});
        picker->choose(folder);
        EXPECT_FALSE(std::dynamic_pointer_cast<MoveTargetPicker>(navigation->presentedViewController()));
        drive.settle();
    };
    drive.writeDocument("Documents/Trip/Notes.txt", "taken");
    choose();
    ASSERT_TRUE(alert()) << "the name is taken there";
    EXPECT_TRUE(alert()->press(0));
    EXPECT_THAT(stack(), ElementsAre("-", "*")) << "the preview stays";

    std::filesystem::remove(folder.path() + "/Notes.txt");
    choose();
    EXPECT_FALSE(alert());
    EXPECT_FALSE(std::filesystem::exists(url.path()));
    EXPECT_THAT(stack(), ElementsAre(top(), "Documents", "Trip", "*"));
    EXPECT_EQ(drive.log->count("DEBUG MoveTarget = " + logText(folder)), 2U);
    EXPECT_EQ(drive.log->count("DEBUG Presented moveTarget"), 2U);
}

} // namespace
