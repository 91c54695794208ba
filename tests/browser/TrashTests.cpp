// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/TrashScreen.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/controllers/Window.h"
#include "kit/views/ListView.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

namespace fs = std::filesystem;

using namespace testing_support;
using kit::RowCommand;
using testing::ElementsAre;
using testing::IsEmpty;

class TrashTest : public BrowserFixture {
protected:
    /// Runs what is due, and the notices of folders and of the trash, which come a moment later.
    void wait()
    {
        for (int round = 0; round < 2; ++round) {
            settle();
            dispatch->advance(1);
        }
        settle();
    }
    /// Answers the question that lies over all other screens.
    std::shared_ptr<kit::AlertController> alert() const
    {
        const auto presented = window->presentedScreens();
        return presented.empty() ? nullptr
                                 : std::dynamic_pointer_cast<kit::AlertController>(presented.back());
    }
    void trash(const std::vector<Url>& items)
    {
        browser->moveItemsToTrash(items);
        wait();
        takeNotices();
    }
    std::shared_ptr<TrashScreen> show()
    {
        browser->showTrash();
        wait();
        const auto presented = window->presentedScreens();
        const auto stack = presented.empty()
            ? nullptr
            : std::dynamic_pointer_cast<kit::NavigationController>(presented.back());
        return stack ? std::dynamic_pointer_cast<TrashScreen>(stack->topViewController()) : nullptr;
    }
    static std::vector<std::string> names(const TrashScreen& screen)
    {
        std::vector<std::string> names;
        for (std::size_t row = 0; row < screen.listView()->rowCount(); ++row)
            names.push_back(screen.listView()->row(row).title);
        std::ranges::sort(names);
        return names;
    }
    static std::size_t rowOf(const TrashScreen& screen, const std::string& name)
    {
        std::size_t row = 0;
        while (row < screen.listView()->rowCount() && screen.listView()->row(row).title != name)
            ++row;
        return row;
    }
    /// Presses an entry of the question on the screen.
    void answer(const std::string& title)
    {
        ASSERT_NE(alert(), nullptr) << title;
        for (const auto& action : alert()->actions()) {
            if (action->title() == title) {
                alert()->press(action);
                return wait();
            }
        }
        FAIL() << "no " << title;
    }
    static void pressTool(const kit::ViewController& screen, const std::string& title)
    {
        const auto items = screen.toolbarItems(); // pressing one may change them
        for (const auto& item : items) {
            if (item->title() == title)
                item->press();
        }
    }
    std::string sideButton() const
    {
        const auto& items = topList()->toolbarItems();
        return items.size() > 3 ? items.back()->title() : std::string();
    }
    std::size_t inTrash() const { return platform::services().trash().items()->size(); }
    bool isThere(std::string_view path) const { return fs::exists(url(path).path()); }
};

TEST_F(TrashTest, TheKeyAndTheMenusMoveToTheTrashWhatCanComeBack)
{
    for (const auto* name : {"a.txt", "b.txt", "c.txt"})
        write(name);
    launch();
    const auto list = topList();
    // Desktop and Documents are the first two rows.
    EXPECT_TRUE(list->listView()->commandRow(2, RowCommand::Delete));
    wait();
    EXPECT_EQ(alert(), nullptr);
    EXPECT_FALSE(isThere("a.txt"));
    EXPECT_THAT(takeNotices(), ElementsAre("“a.txt” was moved to the trash"));
    EXPECT_EQ(sideButton(), "1 in Trash");
    pressNotice();
    wait();
    EXPECT_TRUE(isThere("a.txt"));
    EXPECT_EQ(sideButton(), "");

    browser->beginEditMode(nullptr);
    list->setSelectedItems({url("a.txt"), url("b.txt")});
    EXPECT_TRUE(list->listView()->commandRow(3, RowCommand::Delete));
    wait();
    EXPECT_FALSE(browser->editMode());
    EXPECT_FALSE(isThere("a.txt") || isThere("b.txt"));
    EXPECT_TRUE(isThere("c.txt"));
    EXPECT_EQ(takeNotices().back(), "2 items were moved to the trash");
    EXPECT_TRUE(window->undoRequested());
    wait();
    EXPECT_TRUE(isThere("a.txt") && isThere("b.txt"));

    EXPECT_TRUE(list->listView()->commandRow(2, RowCommand::DeleteForGood));
    wait();
    answer("Delete from Tarrow Drive");
    EXPECT_FALSE(isThere("a.txt"));
    EXPECT_EQ(inTrash(), 0U);
}

TEST_F(TrashTest, WhatCannotGoStaysAndIsSaid)
{
    const auto a = write("a.txt"), b = write("b.txt");
    launch();
    trash({url("Documents"), a});
    ASSERT_NE(alert(), nullptr);
    alert()->press(0);
    wait();
    EXPECT_TRUE(isThere("Documents") && isThere("a.txt"));
    coordinator->whileWaiting = [&] { write("a.txt", "saved meanwhile"); };
    trash({a, b});
    coordinator->whileWaiting = {};
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->title(), "“a.txt” wasn’t moved, because another program has changed it.");
    EXPECT_EQ(contentOf(a), "saved meanwhile");
    EXPECT_FALSE(isThere("b.txt"));
}

TEST_F(TrashTest, TheScreenSaysWhatIsThereAndPutsItBack)
{
    launch();
    const auto empty = show();
    ASSERT_NE(empty, nullptr);
    EXPECT_FALSE(empty->placeholder()->isHidden());
    EXPECT_EQ(empty->placeholder()->content().title, "The trash is empty");
    EXPECT_THAT(empty->navigationItem().rightItems(), IsEmpty());
    browser->showTrash();
    EXPECT_EQ(window->presentedScreens().size(), 1U) << "one is enough";
    empty->dismissViewController(false);
    wait();

    trash({write("Trip/a.txt"), write("b.txt")});
    writeFile(drive.layout().trash() + "/c.txt", "could not be put back");
    const auto screen = show();
    ASSERT_NE(screen, nullptr);
    EXPECT_THAT(names(*screen), ElementsAre("a.txt", "b.txt", "c.txt"));
    EXPECT_TRUE(screen->placeholder()->isHidden());
    EXPECT_THAT(screen->listView()->row(rowOf(*screen, "a.txt")).detail, testing::HasSubstr("Trip"));
    EXPECT_THAT(
        screen->listView()->row(rowOf(*screen, "c.txt")).detail, testing::HasSubstr("Could not be put back"));

    screen->listView()->activateRow(rowOf(*screen, "c.txt"));
    ASSERT_NE(alert(), nullptr);
    EXPECT_EQ(alert()->title(), "c.txt");
    EXPECT_THAT(alert()->message(), testing::HasSubstr("It could not be put back"));
    answer("Restore");
    EXPECT_TRUE(isThere("c.txt"));
    EXPECT_THAT(takeNotices(), ElementsAre("“c.txt” was put back"));
    EXPECT_THAT(names(*screen), ElementsAre("a.txt", "b.txt"));

    write("b.txt", "another");
    screen->listView()->menuForRow(rowOf(*screen, "b.txt"))[0].handler();
    wait();
    answer("Keep Both");
    EXPECT_TRUE(isThere("b 2.txt"));
    EXPECT_EQ(contentOf(url("b.txt")), "another");
    EXPECT_THAT(names(*screen), ElementsAre("a.txt"));
}

TEST_F(TrashTest, TheScreenDeletesForGoodAfterAQuestion)
{
    std::vector<Url> items;
    for (const auto* name : {"a.txt", "b.txt", "c.txt", "d.txt", "e.txt"})
        items.push_back(write(name));
    launch();
    trash(items);
    const auto screen = show();
    ASSERT_NE(screen, nullptr);
    for (const auto command : {RowCommand::Delete, RowCommand::DeleteForGood}) {
        EXPECT_TRUE(screen->listView()->commandRow(0, command));
        ASSERT_NE(alert(), nullptr);
        answer(command == RowCommand::Delete ? "Cancel" : "Delete from Tarrow Drive");
    }
    EXPECT_EQ(inTrash(), 4U);

    screen->setSelecting(true);
    screen->listView()->activateRow(0);
    screen->listView()->activateRow(1);
    EXPECT_EQ(screen->title(), "2 Items Selected");
    pressTool(*screen, "Delete");
    EXPECT_THAT(alert()->message(), testing::HasSubstr("2 items"));
    answer("Delete from Tarrow Drive");
    EXPECT_FALSE(screen->isSelecting());
    EXPECT_EQ(screen->listView()->rowCount(), 2U);

    pressTool(*screen, "Empty Trash");
    answer("Delete from Tarrow Drive");
    EXPECT_EQ(inTrash(), 0U);
    EXPECT_FALSE(screen->placeholder()->isHidden());
}

TEST_F(TrashTest, TheScreenFollowsOtherProgramsAndEndsWithTheAccount)
{
    const auto a = write("a.txt");
    launch();
    post(platform::Notification::ApplicationDidBecomeActive);
    const auto screen = show();
    ASSERT_NE(screen, nullptr);
    ASSERT_TRUE(platform::services().trash().moveToTrash(a.path(), std::nullopt));
    wait();
    EXPECT_THAT(names(*screen), ElementsAre("a.txt"));
    screen->listView()->activateRow(0);
    ASSERT_NE(alert(), nullptr);
    cloud->token = std::nullopt;
    post(platform::Notification::CloudIdentityDidChange);
    wait();
    EXPECT_THAT(window->presentedScreens(), IsEmpty());
    EXPECT_EQ(inTrash(), 1U);
}

TEST_F(TrashTest, WhatIsOldGoesWhenTheDriveIsSetUp)
{
    const auto old = platform::services().trash().moveToTrash(write("old.txt").path(), std::nullopt);
    const auto young = platform::services().trash().moveToTrash(write("young.txt").path(), std::nullopt);
    constexpr auto daysAgo = std::chrono::nanoseconds(std::chrono::days(31));
    const auto date = dispatch->now().nanoseconds;
    const auto record = [&](const TrashedItem& item, std::int64_t nanoseconds) {
        writeFile(drive.layout().trash() + '/' + item.identifier + "/.trwplace",
            "BrindleDefault/x" + std::string(1, '\0') + std::to_string(nanoseconds) + '\0' + "trashed"
                + std::string(1, '\0'));
    };
    record(*old, date - daysAgo.count());
    record(*young, date);
    launch();
    wait();
    const auto left = platform::services().trash().items();
    ASSERT_EQ(left->size(), 1U);
    EXPECT_EQ(left->front().name, "young.txt");
    EXPECT_EQ(sideButton(), "1 in Trash");
}

TEST_F(TrashTest, ContentsWithoutAPromiseAndAliasesShowAsWhatTheyAre)
{
    for (const auto* content : {"one", "two"})
        testing_support::writeFile(drive.layout().cloud() + '/' + content, "data");
    launch();
    trash({drive.writeAlias("Recipes.trwalias", "BrindleDefault/Documents")});
    const auto screen = show();
    ASSERT_NE(screen, nullptr);
    EXPECT_THAT(names(*screen), ElementsAre("Recipes", "Recovered document", "Recovered document"));
    const auto alias = screen->listView()->row(rowOf(*screen, "Recipes"));
    EXPECT_EQ(alias.image->iconName(), "emblem-symbolic-link");
    EXPECT_THAT(screen->listView()->row(1).detail, testing::StartsWith("Without a name"));

    screen->setSelecting(true);
    for (const std::size_t row : {1, 2})
        screen->listView()->activateRow(row);
    pressTool(*screen, "Restore");
    wait();
    EXPECT_EQ(alert(), nullptr) << "both have the same name, and none that anybody has chosen";
    EXPECT_THAT(names(*screen), ElementsAre("Recipes"));
    EXPECT_TRUE(isThere("Documents/.Recovered document.trwpromise"));
    EXPECT_TRUE(isThere("Documents/.Recovered document 2.trwpromise"));
}

} // namespace
} // namespace tarrow
