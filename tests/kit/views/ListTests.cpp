// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TypeAhead.h"
#include "kit/views/ListView.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <numeric>
#include <random>

namespace kit {

namespace {

using Ids = std::vector<RowId>;

Ids applied(Ids rows, const ListChanges& changes, const Ids& after)
{
    for (const auto& splice : changes.splices) {
        const auto at = rows.begin() + static_cast<std::ptrdiff_t>(splice.position);
        rows.erase(at, at + static_cast<std::ptrdiff_t>(splice.removed));
        const auto from = after.begin() + static_cast<std::ptrdiff_t>(splice.position);
        rows.insert(rows.begin() + static_cast<std::ptrdiff_t>(splice.position), from,
            from + static_cast<std::ptrdiff_t>(splice.inserted));
    }
    return rows;
}

/// Answers about two thirds of the identifiers below a limit, in their order.
Ids some(std::mt19937& random, RowId limit)
{
    Ids ids;
    for (RowId id = 0; id < limit; ++id)
        if (random() % 3 != 0)
            ids.push_back(id);
    return ids;
}

/// Rows that are numbered by their identifiers. Every seventh identifier is a header.
class Source : public ListViewDataSource {
public:
    explicit Source(std::size_t count)
        : ids(count)
    {
        std::iota(ids.begin(), ids.end(), 1);
    }
    std::size_t numberOfRows(const ListView&) const override { return ids.size(); }
    ListRow rowAtIndex(const ListView& list, std::size_t index) const override
    {
        ++made;
        ListRow row;
        row.id = ids[index];
        row.kind = rowKindAtIndex(list, index);
        return row;
    }
    RowId rowIdAtIndex(const ListView&, std::size_t index) const override { return ids[index]; }
    RowKind rowKindAtIndex(const ListView&, std::size_t index) const override
    {
        return ids[index] % 7 == 0 ? RowKind::SectionHeader : RowKind::Item;
    }
    Ids ids;
    mutable int made = 0;
};

class Delegate : public ListViewDelegate {
public:
    void rowActivated(ListView&, std::size_t index) override { activated.push_back(index); }
    Menu menuForRow(ListView&, std::size_t) override
    {
        return {{"Delete", {}, MenuActionStyle::Destructive, true, {}}};
    }
    void visibleRowsDidChange(ListView&, RowRange range) override { visible.push_back(range); }
    void selectionDidChange(ListView& list) override { selected.push_back(list.selection().count()); }
    void refreshRequested(ListView&) override { ++refreshes; }

    std::vector<std::size_t> activated, selected;
    std::vector<RowRange> visible;
    int refreshes = 0;
};

class List : public testing::Test {
protected:
    void use(std::size_t rows)
    {
        source = std::make_shared<Source>(rows);
        list->setListDelegate(delegate);
        list->setDataSource(source);
        list->layoutIfNeeded();
    }

    std::shared_ptr<ListView> list = std::make_shared<ListView>(Rect{0, 0, 360, 600});
    std::shared_ptr<Delegate> delegate = std::make_shared<Delegate>();
    std::shared_ptr<Source> source;
};

} // namespace

TEST_F(List, OnlyWhatIsSeenIsAskedFor)
{
    list->setRowHeight(60); // in a list of 600
    use(100'000);
    EXPECT_EQ(delegate->visible.back(), (RowRange{0, 10}));
    list->userScrolled({0, 30});
    EXPECT_EQ(delegate->visible.back(), (RowRange{0, 11}));
    const auto told = delegate->visible.size();
    list->userScrolled({0, 31});
    EXPECT_EQ(delegate->visible.size(), told);
    list->scrollToRow(99'999, RowPosition::Top, true);
    EXPECT_EQ(delegate->visible.back(), (RowRange{99'990, 10}));
    list->scrollToRow(500, RowPosition::Nearest, false);
    EXPECT_EQ(list->contentOffset().y, 500 * 60);
    list->scrollToRow(512, RowPosition::Nearest, false);
    EXPECT_EQ(list->contentOffset().y, 503 * 60);
    list->userScrolled({0, -80});
    EXPECT_EQ(delegate->visible.back(), (RowRange{0, 9}));
    EXPECT_EQ(source->made, 0);
}

TEST_F(List, TapsOpenOrSelectAndLateOnesAreIgnored)
{
    use(20);
    list->activateRow(3);
    list->activateRow(6); // a header
    list->activateRow(20);
    EXPECT_EQ(delegate->activated, std::vector<std::size_t>{3});
    EXPECT_EQ(list->menuForRow(3).size(), 1);
    EXPECT_TRUE(list->menuForRow(6).empty());
    EXPECT_EQ(list->row(3).check, CheckState::None);

    list->setSelectionMode(SelectionMode::Multiple);
    list->activateRow(3);
    list->extendSelectionTo(8);
    list->activateRow(4);
    EXPECT_EQ(delegate->activated.size(), 1);
    EXPECT_EQ(delegate->selected, (std::vector<std::size_t>{1, 5, 4}));
    EXPECT_EQ(list->row(3).check, CheckState::On);
    EXPECT_EQ(list->row(4).check, CheckState::Off);
    EXPECT_EQ(list->row(6).check, CheckState::None);
    EXPECT_TRUE(list->menuForRow(3).empty());

    const Ids before = source->ids;
    source->ids.erase(source->ids.begin(), source->ids.begin() + 4);
    list->apply(ListChanges::between(before, source->ids));
    EXPECT_EQ(list->selection().inOrder(list->rowIds()), (Ids{6, 8, 9}));
    list->selectAll();
    EXPECT_EQ(list->selection().count(), 14);
    list->setSelectionMode(SelectionMode::None);
    EXPECT_TRUE(list->selection().isEmpty());
}

TEST_F(List, ARangeIsRedrawnUntilAnotherRowIsTouched)
{
    Ids order(40);
    std::iota(order.begin(), order.end(), 0);
    SelectionModel selection;
    selection.toggle(2);
    selection.toggle(10);
    selection.extendTo(14, order);
    EXPECT_EQ(selection.inOrder(order), (Ids{2, 10, 11, 12, 13, 14}));
    selection.extendTo(8, order);
    EXPECT_EQ(selection.inOrder(order), (Ids{2, 8, 9, 10}));
    selection.toggle(10); // off: a range from here deselects
    selection.extendTo(2, order);
    EXPECT_TRUE(selection.isEmpty());
    selection.extendTo(9, order);
    EXPECT_EQ(selection.inOrder(order), (Ids{2, 8}));

    selection.selectAll(order);
    EXPECT_EQ(selection.count(), order.size());
    for (RowId id = 0; id < 40; id += 2)
        selection.deselect(id);
    for (RowId id = 0; id < 40; ++id)
        EXPECT_EQ(selection.contains(id), id % 2 == 1) << id;
    EXPECT_TRUE(selection.keepOnly(std::span(order).first(20)));
    EXPECT_EQ(selection.count(), 10);
    EXPECT_FALSE(selection.keepOnly(order));
}

TEST_F(List, ManyChangesAreFewAwayFromWhatIsSeen)
{
    std::mt19937 random(7);
    for (int round = 0; round < 200; ++round) {
        const Ids before = some(random, 300), after = some(random, 300);
        const RowRange seen{random() % before.size(), 10};
        const auto changes = ListChanges::between(before, after);
        const auto few = changes.splicesExactWithin(seen);
        EXPECT_EQ(applied(before, {few, {}}, after), after);
        EXPECT_LE(few.size(), seen.count + 3);
        // No splice contains a visible row that stays.
        std::size_t grown = 0, shrunk = 0;
        for (const auto& splice : few) {
            const auto first = splice.position + shrunk - grown;
            for (auto row = first; row < first + splice.removed; ++row) {
                const bool isSeen = seen.contains(row) && row < before.size();
                EXPECT_FALSE(isSeen && std::ranges::binary_search(after, before[row]));
            }
            grown += splice.inserted;
            shrunk += splice.removed;
        }
    }
}

TEST_F(List, TypingAheadGathersATextAndRepeatsALetter)
{
    const struct {
        const char* typed;
        double at; ///< seconds
        const char* sought;
        std::size_t start; ///< with the keyboard at row 5
    } rows[] = {
        {"n", 0, "n", 6},
        {"n", 0.3, "n", 6},
        {"o", 0.6, "nno", 5},
        {"a", 3, "a", 6},
        {"b", 3.5, "ab", 5},
        {"\xC3\xA4", 9, "\xC3\xA4", 6},
        {"\xC3\xA4", 9.1, "\xC3\xA4", 6},
    };
    TypeAhead text;
    for (const auto& row : rows) {
        text.type(row.typed, Date::fromSeconds(1000 + row.at));
        EXPECT_EQ(text.sought(), row.sought);
        EXPECT_EQ(text.start(5), row.start);
    }
    EXPECT_FALSE(text.isActive(Date::fromSeconds(1020)));
}

TEST_F(List, RefreshesOnceAtATime)
{
    use(1);
    list->setRefreshable(true);
    list->pulledToRefresh();
    list->pulledToRefresh();
    EXPECT_EQ(delegate->refreshes, 1);
}

TEST_F(List, OutlivesItsDataSource)
{
    use(5);
    list->setSelectionMode(SelectionMode::Multiple);
    source.reset();
    list->activateRow(1);
    list->extendSelectionTo(2);
    EXPECT_EQ(list->row(1), ListRow());
    list->reloadAll();
    EXPECT_EQ(list->rowCount(), 0);
}

TEST(Difference, IsExact)
{
    const struct {
        const char* name;
        Ids before, after;
        std::vector<ListSplice> splices;
    } rows[] = {
        {"the same", {1, 2, 3}, {1, 2, 3}, {}},
        {"filled", {}, {1, 2}, {{0, 0, 2}}},
        {"emptied", {1, 2}, {}, {{0, 2, 0}}},
        {"inserted at the top", {1, 2, 3}, {9, 1, 2, 3}, {{0, 0, 1}}},
        {"renamed in its place", {1, 2, 3}, {1, 8, 3}, {{1, 1, 1}}},
        {"moved down", {1, 2, 3, 4}, {2, 3, 1, 4}, {{0, 1, 0}, {2, 0, 1}}},
        {"two places", {1, 2, 3, 4, 5}, {1, 3, 4, 7, 8, 5}, {{1, 1, 0}, {3, 0, 2}}},
    };
    for (const auto& row : rows) {
        const auto changes = ListChanges::between(row.before, row.after);
        EXPECT_EQ(changes.splices, row.splices) << row.name;
        EXPECT_EQ(applied(row.before, changes, row.after), row.after) << row.name;
    }
}

TEST(Difference, HoldsForAnyTwoOrders)
{
    std::mt19937 random(7);
    for (int round = 0; round < 300; ++round) {
        Ids before = some(random, 30), after = some(random, 30);
        if (round % 2 == 0)
            std::shuffle(after.begin(), after.end(), random);
        ASSERT_EQ(applied(before, ListChanges::between(before, after), after), after);
    }
}

} // namespace kit
