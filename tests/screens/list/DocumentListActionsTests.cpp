// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// These tests are about the user's actions in a folder's list: tap, choose, select, type, search.

#include "tests/screens/support/DocumentListFixture.h"

#include "host/drive/records/ItemFacts.h"
#include "kit/controllers/SearchPresentation.h"
#include "screens/FolderPlaces.h"

#include <map>

using namespace platform;
using namespace screens;
using namespace testing_support;

namespace {

using Kind = FolderEntryKind;

TEST_F(DocumentList, ReportsWhatIsTapped)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(
        list, {{"Trip", Kind::Folder}, {"Notes.txt"}, {"Letter.pages", Kind::Package}, {"To", Kind::Link}});
    EXPECT_EQ(delegate->take(), (Lines{"changed 4 selected 0"}));
    for (std::size_t row = 0; row < 5; ++row)
        list->listView()->activateRow(row);
    EXPECT_EQ(
        delegate->take(), (Lines{"folder Trip Trip", "item Notes.txt", "item Letter.pages", "item To"}));
}

TEST_F(DocumentList, DimsTheRowsOfItemsThatAreActedOnOrChanged)
{
    const auto folder = drive.makeFolder("Stuff");
    const auto list = shownList(folder);
    const auto a = drive.url("Stuff/a.txt"), b = drive.url("Stuff/b.txt");
    list->setChangingItems({b});
    deliver(list, {{"a.txt"}, {"b.txt"}, {"c.txt"}});
    list->setAvailableActions(125);
    const auto dimmed = [&] {
        std::string rows;
        for (std::size_t row = 0; row < 3; ++row)
            rows += list->listView()->row(row).isDimmed ? '-' : 'o';
        return rows;
    };
    EXPECT_EQ(dimmed(), "o-o") << "the change began before the rows came";
    list->setChangingItems({a, drive.url("Other/c.txt")});
    EXPECT_EQ(dimmed(), "-oo");
    list->setChangingItems({});
    EXPECT_EQ(dimmed(), "ooo");

    list->listView()->commandRow(2, kit::RowCommand::Delete);
    list->listView()->commandRow(2, kit::RowCommand::Rename);
    list->setChangingItems({a});
    EXPECT_EQ(dimmed(), "-o-");
    ASSERT_EQ(delegate->completions.size(), 2);
    delegate->completions[1]();
    EXPECT_EQ(dimmed(), "-o-") << "one of two actions goes on";
    delegate->completions[0]();
    delegate->completions[0]();
    EXPECT_EQ(dimmed(), "-oo");
}

TEST_F(DocumentList, OffersTheEnabledActionsByMenuAndKeys)
{
    makePaintLibrary();
    const auto list = shownList(*DocumentListController::createRootList()->presentedURL());
    deliver(list, {{"Notes.txt"}});
    delegate->take();
    EXPECT_TRUE(list->listView()->menuForRow(1).empty());

    list->setAvailableActions(125);
    for (const auto& entry : list->listView()->menuForRow(1))
        entry.handler();
    EXPECT_EQ(delegate->take(),
        (Lines{"action 2 Notes.txt", "action 4 Notes.txt", "action 3 Notes.txt", "action 5 Notes.txt",
            "action 0 Notes.txt"}));

    Lines titlesOfLibrary;
    for (const auto& entry : list->listView()->menuForRow(0))
        titlesOfLibrary.push_back(entry.title);
    EXPECT_EQ(titlesOfLibrary, (Lines{"Info", "Share", "Delete"}));

    const auto press = [&](std::size_t row, kit::RowCommand command) {
        return list->listView()->commandRow(row, command);
    };
    EXPECT_TRUE(press(1, kit::RowCommand::Info));
    EXPECT_TRUE(press(1, kit::RowCommand::Rename));
    EXPECT_FALSE(press(0, kit::RowCommand::Rename)) << "not for a library";
    EXPECT_FALSE(press(1, kit::RowCommand::Peek)) << "nothing to show";
    EXPECT_FALSE(press(7, kit::RowCommand::Info));
    list->setAvailableActions(125 & ~actionBit(DocumentListAction::Delete));
    EXPECT_FALSE(press(1, kit::RowCommand::Delete));
    EXPECT_EQ(delegate->take(), (Lines{"action 2 Notes.txt", "action 3 Notes.txt"}));
}

TEST_F(DocumentList, CopiesAndDragsWhatIsHereAndNoLibraries)
{
    makePaintLibrary();
    const auto list = shownList(*DocumentListController::createRootList()->presentedURL());
    deliver(list, {{"a.txt"}, {"b.txt"}, {.name = "far.txt", .isPromise = true}});
    list->setAvailableActions(125);
    Lines copied;
    list->setCopyItems([&](const std::vector<Url>& items) {
        for (const auto& item : items)
            copied.push_back(item.lastPathComponent());
    });
    const auto choose = [&](kit::Menu menu) {
        const auto entry = std::ranges::find(menu, "Copy", &kit::MenuAction::title);
        if (entry != menu.end())
            entry->handler();
        return std::exchange(copied, {});
    };
    auto& rows = *list->listView();
    EXPECT_EQ(choose(rows.menuForRow(0)), Lines()) << "a library";
    EXPECT_EQ(choose(rows.menuForRow(1)), (Lines{"a.txt"}));
    EXPECT_EQ(choose(rows.menuForRow(3)), Lines()) << "in the cloud";
    const auto press = [&](std::size_t row) {
        rows.commandRow(row, kit::RowCommand::Copy);
        return std::exchange(copied, {});
    };
    EXPECT_EQ(press(0), Lines());
    EXPECT_EQ(press(3), (Lines{"far.txt"})) << "the answer says why it cannot be";
    const auto drag = [&](std::size_t row) {
        Lines names;
        for (const auto& file : rows.filesToDrag(row))
            names.push_back(file.lastPathComponent());
        return names;
    };
    for (const std::size_t row : {0, 3})
        EXPECT_EQ(drag(row), Lines());
    EXPECT_EQ(drag(1), (Lines{"a.txt"}));
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("a.txt"), drive.url("far.txt")});
    EXPECT_EQ(drag(1), Lines()) << "one of the selected ones is in the cloud";
    list->setSelectedItems({drive.url("a.txt"), drive.url("b.txt")});
    EXPECT_EQ(drag(1), (Lines{"a.txt", "b.txt"}));
    EXPECT_EQ(press(1), (Lines{"a.txt", "b.txt"}));
    EXPECT_EQ(press(3), (Lines{"far.txt"})) << "it is not among the selected ones";
    EXPECT_EQ(choose(rows.menuForList()), (Lines{"a.txt", "b.txt"}));
}

TEST_F(DocumentList, OffersTheTrashBesideDeletionButNotToLibraries)
{
    makePaintLibrary();
    const auto list = shownList(*DocumentListController::createRootList()->presentedURL());
    deliver(list, {{"a.txt"}, {"b.txt"}});
    list->setAvailableActions(125);
    Lines moved;
    list->setTrashVerbs({[&](const std::vector<Url>& items) {
                             for (const auto& item : items)
                                 moved.push_back(item.lastPathComponent());
                         },
        [&] { moved.emplace_back("shown"); }});
    const auto titles = [](const kit::Menu& menu) {
        Lines lines;
        for (const auto& entry : menu)
            lines.push_back(entry.title);
        return lines;
    };
    EXPECT_EQ(titles(list->listView()->menuForRow(0)), (Lines{"Info", "Share", "Delete"}));
    EXPECT_EQ(titles(list->listView()->menuForRow(1)),
        (Lines{"Info", "Share", "Rename", "Move", "Move to Trash", "Delete"}));
    list->listView()->menuForRow(1)[4].handler();
    EXPECT_EQ(list->optionsMenu().back().title, "Trash");
    list->optionsMenu().back().handler();
    EXPECT_EQ(std::exchange(moved, {}), (Lines{"a.txt", "shown"}));

    delegate->take();
    EXPECT_TRUE(list->listView()->commandRow(0, kit::RowCommand::Delete));
    EXPECT_TRUE(list->listView()->commandRow(1, kit::RowCommand::Delete));
    EXPECT_TRUE(list->listView()->commandRow(1, kit::RowCommand::DeleteForGood));
    EXPECT_EQ(std::exchange(moved, {}), Lines{"a.txt"});
    EXPECT_EQ(delegate->take(), (Lines{"action 0 Documents", "action 0 a.txt"}));
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("a.txt"), drive.url("b.txt")});
    EXPECT_TRUE(list->listView()->commandRow(2, kit::RowCommand::Delete));
    EXPECT_EQ(std::exchange(moved, {}), (Lines{"a.txt", "b.txt"}));
    list->setSelectedItems({drive.url("a.txt")});
    EXPECT_TRUE(list->listView()->commandRow(2, kit::RowCommand::Delete));
    EXPECT_EQ(moved, Lines{"b.txt"}) << "the key was pressed at another item";
}

TEST_F(DocumentList, AHeldRowShowsItsScreenWithWhatCanBeDoneWithIt)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a.txt"}, {"b.txt"}});
    list->setAvailableActions(125);
    delegate->take();
    delegate->preview = std::make_shared<kit::ViewController>();
    const auto peek = [&] {
        EXPECT_TRUE(list->listView()->commandRow(1, kit::RowCommand::Peek));
        drive.dispatch->runUntilIdle();
        return alertOver(*list);
    };
    auto shown = peek();
    ASSERT_TRUE(shown);
    EXPECT_EQ(shown->title(), "b.txt");
    shown->view();
    EXPECT_TRUE(delegate->preview->parent());
    shown->press(shown->preferredAction());
    EXPECT_EQ(delegate->take(), Lines{"action 6 b.txt"});
    EXPECT_FALSE(delegate->preview->parent());

    list->setAvailableActions(actionBit(DocumentListAction::Info));
    shown = peek();
    EXPECT_EQ(shown->actions().size(), 3U); // open, info, cancel
    shown->press(shown->preferredAction());
    EXPECT_EQ(delegate->take(), Lines{"item b.txt"});

    list->setEditingAnimated(true, false);
    EXPECT_FALSE(list->listView()->holdRow(1));
}

TEST_F(DocumentList, FindsRowsByWhatIsTypedInEveryScript)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    const HandLister::Entries entries{{"cafe.txt"}, {"Caf\u00e9 two"}, {"Cafe\u0301 three"},
        {"\u041e\u0442\u0447\u0451\u0442 1"}, {"\u041e\u0442\u0447\u0435\u0442 2"}, {"\u00c9"},
        {"\uff34\uff4f"}, {"no\xffutf8"}, {"x"}};
    deliver(list, entries);
    const struct {
        const char* typed;
        std::size_t from;
        std::optional<std::size_t> found;
    } rows[] = {
        {"CAF\u00c9 T", 0, 1},
        {"cafe th", 0, 2},
        {"\u043e\u0442\u0447\u0435\u0442", 0, 3},
        {"\u00e9", 6, 5}, // from the top again
        {"to", 0, 6},
        {"no", 0, 7},
        {"xx", 0, std::nullopt},
    };
    for (const auto& row : rows)
        EXPECT_EQ(list->listView()->rowBeginningWith(row.typed, row.from), row.found) << row.typed;
}

TEST_F(DocumentList, SelectingByTheKeyboardAsksForEditMode)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}, {"b"}, {"c"}, {"d"}});
    delegate->take();
    list->listView()->selectAllByUser();
    EXPECT_EQ(list->selectedItemCount(), 0U);
    EXPECT_EQ(delegate->take(), Lines{"wants to select"});

    delegate->allowsEditing = true;
    list->listView()->extendSelectionTo(1);
    list->listView()->extendSelectionTo(3);
    EXPECT_EQ(list->selectedItemCount(), 3U);
    list->listView()->extendSelectionTo(0);
    EXPECT_EQ(list->selectedItems(), (std::vector{drive.url("Stuff/a"), drive.url("Stuff/b")}));
}

TEST_F(DocumentList, SelectsWhileEditingAndKeepsTheSelectionThroughChanges)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    list->setAvailableActions(125);
    deliver(list, {{"a"}, {"b"}, {"c"}, {"d"}});
    list->setSelectedItems({drive.url("Stuff/a")});
    EXPECT_TRUE(list->selectedItems().empty());

    list->setEditingAnimated(true, true);
    delegate->take();
    list->listView()->activateRow(3);
    list->listView()->activateRow(1);
    EXPECT_EQ(delegate->take(), (Lines{"changed 4 selected 1", "changed 4 selected 2"}));
    EXPECT_TRUE(list->listView()->menuForRow(0).empty());

    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);
    deliver(list, {{"0"}, {"a"}, {"b"}, {"d"}});
    EXPECT_EQ(list->selectedItems(), (std::vector{drive.url("Stuff/b"), drive.url("Stuff/d")}));
    EXPECT_EQ(observer->last.splices, (std::vector<kit::ListSplice>{{0, 0, 1}, {3, 1, 0}}));
    EXPECT_EQ(observer->resets, 0);
    EXPECT_EQ(list->listView()->row(2).check, kit::CheckState::On);

    deliver(list, {{"a"}, {"b"}});
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/b")});
    list->setSelectedItems({drive.url("Stuff/a"), drive.url("Stuff/gone"), drive.url("Elsewhere/b")});
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/a")});
    list->setEditingAnimated(false, true);
    EXPECT_EQ(list->selectedItemCount(), 0U);
}

TEST_F(DocumentList, SearchesTheWholeDriveAndSaysWhereItemsLie)
{
    drive.writeDocument("Stuff/Spain/My trip.txt");
    drive.makeFolder("Stuff/Trip");
    drive.mark(drive.writeDocument("trip plan.txt"), host::drive::itemMark::tags, "Travel");
    const auto list = shownList(drive.url("Stuff"));
    list->startSearchWithQueryStringBecomeFirstResponder("TRIP", true);
    drive.dispatch->runUntilIdle();
    const auto search = std::dynamic_pointer_cast<kit::SearchPresentation>(list->presentedViewController());
    ASSERT_TRUE(search);
    EXPECT_TRUE(search->hasFocus());
    const auto results = std::dynamic_pointer_cast<kit::ListView>(search->view()->subviews().front());
    ASSERT_TRUE(results);
    results->setFrame({0, 0, 360, 600});
    results->layoutIfNeeded();
    drive.dispatch->runUntilIdle();
    std::map<std::string, std::string> places;
    for (std::size_t row = 0; row < results->rowCount(); ++row)
        places[results->row(row).title] = results->row(row).detail;
    EXPECT_THAT(places,
        testing::ElementsAre(testing::Pair("My trip.txt", testing::StartsWith("Stuff › Spain · ")),
            testing::Pair("Trip", testing::StartsWith("Stuff · ")),
            testing::Pair("trip plan.txt", testing::StartsWith(folderTitle(drive.url(""))))));

    delegate->take();
    list->setAvailableActions(125);
    std::size_t plan = 0;
    while (results->row(plan).title != "trip plan.txt")
        ++plan;
    EXPECT_EQ(results->row(plan).tagDots.size(), 1U);
    for (const auto& entry : results->menuForRow(plan)) {
        if (entry.title != "Show in Its Folder")
            entry.handler();
    }
    EXPECT_TRUE(results->commandRow(plan, kit::RowCommand::Rename));
    Lines actions;
    for (const int action : {2, 4, 3, 5, 0, 3})
        actions.push_back("action " + std::to_string(action) + " trip plan.txt");
    EXPECT_EQ(delegate->take(), actions);

    delegate->preview = std::make_shared<kit::ViewController>();
    EXPECT_TRUE(results->holdRow(plan));
    drive.dispatch->runUntilIdle();
    const auto peek = std::dynamic_pointer_cast<kit::AlertController>(search->presentedViewController());
    ASSERT_TRUE(peek);
    EXPECT_EQ(peek->actions()[1]->title(), "Show in Its Folder");

    search->userEditedQuery("");
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(results->rowCount(), 0U);
}

} // namespace
