// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// These tests are about the list of a folder as a whole: its states, its order, and its place in the drive.

#include "tests/screens/support/DocumentListFixture.h"

#include "kit/controllers/NavigationItem.h"
#include "screens/PlaceholderView.h"

#include <cerrno>

using namespace platform;
using namespace screens;
using testing::HasSubstr;
using namespace testing_support;

namespace {

using Kind = FolderEntryKind;

TEST_F(DocumentList, TakesTheNewestOfManyStates)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    // Each snapshot is large enough to be compared in the background, and comes before the comparison of the
    // one before has ended.
    for (const auto count : {3000U, 5000U, 4000U})
        lister->deliver(*list->presentedURL(), documents(count));
    EXPECT_EQ(list->containedItemCount(), 0U);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(list->containedItemCount(), 4000U);
    EXPECT_EQ(list->listView()->rowCount(), 4000U);
    EXPECT_EQ(delegate->take(), (Lines{"changed 3000 selected 0", "changed 4000 selected 0"}));
}

TEST_F(DocumentList, SaysThatAFolderIsLoadingEmptyOrUnreadable)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    const auto& placeholder = *list->placeholder();
    EXPECT_TRUE(placeholder.isHidden());
    drive.dispatch->advance(1);
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_TRUE(placeholder.content().isBusy);

    deliver(list, {});
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_EQ(placeholder.content().title, "Folder is empty");
    deliver(list, {{"a"}});
    EXPECT_TRUE(placeholder.isHidden());

    lister->fail(*list->presentedURL(), Error(errorDomain::system, EACCES));
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_EQ(placeholder.content().title, "This folder cannot be shown");
    EXPECT_THAT(placeholder.content().message, HasSubstr("permission"));

    const auto quick = shownList(drive.makeFolder("Quick"));
    deliver(quick, {{"a"}});
    drive.dispatch->advance(1);
    EXPECT_TRUE(quick->placeholder()->isHidden());
}

TEST_F(DocumentList, ReportsARemovedFolderOnceAndOnlyWhileItIsShown)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}});
    list->beginAppearance(false, false);
    list->endAppearance();
    delegate->take();
    lister->fail(*list->presentedURL(), Error(FileErrorCode::NoSuchItem));
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(delegate->take(), (Lines{"changed 0 selected 0"}));

    list->beginAppearance(true, false);
    list->endAppearance();
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(delegate->take(), (Lines{"removed Stuff"}));
    lister->fail(*list->presentedURL(), Error(FileErrorCode::NoSuchItem));
    EXPECT_EQ(delegate->take(), (Lines{"changed 0 selected 0"}));
}

TEST_F(DocumentList, ShowsItsItemsInTheChosenOrder)
{
    using Direction = OrderDirection;
    const auto setTime = [&](const char* name, int seconds) {
        const std::filesystem::file_time_type time{std::chrono::seconds(seconds)};
        std::filesystem::last_write_time(drive.url(name).path(), time);
    };
    drive.writeDocument("Stuff/a.txt", "12345");
    drive.writeDocument("Stuff/b.pdf", "1");
    drive.writeDocument("Stuff/c.txt", "123");
    drive.makeFolder("Stuff/Z");
    host::drive::PromiseRecord far;
    far.size = 4;
    drive.writePromise("Stuff/far.txt", far);
    setTime("Stuff/a.txt", 10);
    setTime("Stuff/b.pdf", 30);
    setTime("Stuff/c.txt", 20);
    const struct {
        ListOrder order;
        Lines titles;
    } rows[] = {
        {{OrderKey::Name, Direction::Descending}, {"Z", "far.txt", "c.txt", "b.pdf", "a.txt"}},
        {{OrderKey::Date, Direction::Descending}, {"Z", "b.pdf", "c.txt", "a.txt", "far.txt"}},
        {{OrderKey::Date, Direction::Ascending}, {"Z", "far.txt", "a.txt", "c.txt", "b.pdf"}},
        {{OrderKey::Size, Direction::Descending}, {"Z", "a.txt", "far.txt", "c.txt", "b.pdf"}},
        {{OrderKey::Kind, Direction::Ascending}, {"Z", "b.pdf", "a.txt", "c.txt", "far.txt"}},
    };
    const HandLister::Entries entries{
        {"Z", Kind::Folder}, {"a.txt"}, {"b.pdf"}, {"c.txt"}, {"far.txt", Kind::Document, true}};
    const auto list = shownList(drive.url("Stuff"));
    deliver(list, entries);
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("Stuff/c.txt")});
    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);
    for (const auto& row : rows) {
        list->setOrder(row.order);
        deliver(list, entries);
        EXPECT_EQ(std::exchange(observer->resets, 0), 1) << "another order is another list";
        EXPECT_EQ(titles(*list->listView()), row.titles);
        EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/c.txt")});
        EXPECT_EQ(shownList(drive.url("Stuff"))->order(), row.order) << "kept for the folder";
    }
    list->setOrder({OrderKey::Name, Direction::Ascending, FolderGrouping::Mixed});
    EXPECT_EQ(lister->grouping(), FolderGrouping::Mixed);
    EXPECT_EQ(shownList(drive.makeFolder("Other"))->order(), ListOrder());
}

TEST_F(DocumentList, OffersTheOrdersInAMenu)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}, {"b"}});
    const auto choose = [&](const std::string& title) {
        for (const auto& entry : list->listView()->menuForList()) {
            if (entry.title == title)
                entry.handler();
        }
    };
    const auto marked = [&] {
        Lines titles;
        for (const auto& entry : list->navigationItem().menu()())
            if (entry.mark == kit::MenuMark::On)
                titles.push_back(entry.title);
        return titles;
    };
    EXPECT_EQ(marked(), (Lines{"Name", "Ascending", "Folders First"}));
    choose("Size");
    EXPECT_EQ(marked(), (Lines{"Size", "Descending", "Folders First"}));
    choose("Ascending");
    choose("Folders First");
    EXPECT_EQ(marked(), (Lines{"Size", "Ascending"}));
    list->setEditingAnimated(true, false);
    deliver(list, {{"a"}, {"b"}});
    choose("Select All");
    EXPECT_EQ(list->selectedItemCount(), 2U);
    choose("Select None");
    EXPECT_EQ(list->selectedItemCount(), 0U);
}

TEST_F(DocumentList, RevealsWhatWasMadeWhenItComes)
{
    const auto list = shownList(drive.url("Stuff"));
    HandLister::Entries entries;
    for (int i = 0; i < 1000; ++i)
        entries.push_back({"file " + std::to_string(i)});
    deliver(list, entries);
    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);
    list->reveal(drive.url("Elsewhere/new.txt"));
    list->reveal(drive.url("Stuff/new.txt"));
    EXPECT_THAT(observer->focused, testing::IsEmpty());
    entries.push_back({"new.txt"});
    deliver(list, entries);
    EXPECT_EQ(observer->focused, std::vector<std::size_t>{1000});
    deliver(list, entries);
    EXPECT_EQ(observer->focused.size(), 1U) << "once";

    list->reveal(drive.url("Stuff/late.txt"));
    drive.dispatch->advance(6);
    entries.push_back({"late.txt"});
    deliver(list, entries);
    EXPECT_EQ(observer->focused.size(), 1U) << "the user does something else by now";
}

TEST_F(DocumentList, ListsAnewWhenItIsPulled)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}});
    list->listView()->pulledToRefresh();
    EXPECT_TRUE(list->listView()->isRefreshing());
    EXPECT_EQ(lister->listingsStarted(), 2U);
    deliver(list, {{"a"}, {"b"}});
    EXPECT_FALSE(list->listView()->isRefreshing());
    EXPECT_EQ(titles(*list->listView()), (Lines{"a", "b"}));
}

TEST_F(DocumentList, KnowsTheWayIntoALibraryAndNoneOutOfTheDrive)
{
    Lines names;
    const auto sketches = makePaintLibrary().appendingPathComponent("Sketches");
    for (const auto& list : DocumentListController::hierarchyForURL(sketches))
        names.push_back(list->title());
    EXPECT_THAT(names, testing::ElementsAre(testing::_, "Paint", "Sketches"));
    for (const auto& outside : {std::string("/tmp"), drive.layout().trash()})
        EXPECT_TRUE(DocumentListController::hierarchyForURL(Url::fileURL(outside)).empty());
}

} // namespace
