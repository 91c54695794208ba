// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file fills row widgets: visible rows at once, those beside them a few in each frame. The rows further
// away have no parts, because a list keeps 205 rows, and all of them may have to go in one turn when items
// are deleted.

#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"

#include <algorithm>

namespace host::gtk {

namespace {

/// So many invisible rows are filled in one frame, so that the frame stays short.
constexpr std::size_t rowsInAFrame = 6;
/// So many rows beside the visible ones are filled with them, so that a layout that is a little late shows no
/// empty row.
constexpr std::size_t seenMargin = 2;

/// Rows that are so near to the visible ones get their parts, and rows that are further away than the second
/// number lose them.
constexpr std::size_t nearMargin = 20, farMargin = 50;

bool isWithin(const kit::ListView& list, std::size_t row, std::size_t margin)
{
    const auto visible = list.visibleRows();
    return row + margin >= visible.first && row < visible.end() + margin;
}

bool isSeen(const kit::ListView& list, std::size_t row)
{
    return isWithin(list, row, seenMargin);
}

} // namespace

void ListViewPeer::bindRow(GtkListItem* item)
{
    const auto list = _list.lock();
    const guint position = gtk_list_item_get_position(item);
    _unfilled.erase(item);
    if (!list || position >= list->rowCount())
        return;
    auto* row = gtk_list_item_get_child(item);
    const auto margin = ListRowWidget::isShown(row) ? farMargin : nearMargin;
    const auto fill = isWithin(*list, position, margin) ? ListRowWidget::show : ListRowWidget::announce;
    fill(row, list->row(position), list->rowHeight());
}

void ListViewPeer::fillAfterScrolling()
{
    noteMisfits();
    fillSeenRows();
    if (!_unfilled.empty())
        fillLater();
}

/// Notes the rows that have come near without parts, and those that have gone far with theirs.
void ListViewPeer::noteMisfits()
{
    const auto list = _list.lock();
    for (auto* item : _live) {
        const bool isShown = ListRowWidget::isShown(gtk_list_item_get_child(item));
        const auto margin = isShown ? farMargin : nearMargin;
        if (list && isWithin(*list, gtk_list_item_get_position(item), margin) != isShown)
            _unfilled.insert(item);
    }
}

void ListViewPeer::fillSoon(GtkListItem* item)
{
    const auto list = _list.lock();
    // Between two splices of one change a row is not at its final place, so it is filled later.
    if (list && !_isSplicing && isSeen(*list, gtk_list_item_get_position(item))) {
        bindRow(item);
        context().firstList().note(_listWidget);
        return;
    }
    if (list)
        ListRowWidget::reserve(gtk_list_item_get_child(item), list->rowHeight());
    _unfilled.insert(item);
    fillLater();
}

void ListViewPeer::fillAllSoon()
{
    _unfilled = _live;
    fillLater();
}

void ListViewPeer::fillLater()
{
    context().scheduler().schedule(&_fillKey, [this] { fillRows(); });
}

void ListViewPeer::fillRows()
{
    noteMisfits();
    fillSeenRows();
    auto others = unfilledBesideSeen();
    const bool areMore = others.size() > rowsInAFrame;
    others.resize(std::min(others.size(), rowsInAFrame));
    for (auto* item : others)
        bindRow(item);
    if (areMore)
        context().scheduler().scheduleNextFrame(&_fillKey, [this] { fillRows(); });
    if (!_live.empty())
        context().firstList().note(_listWidget);
}

void ListViewPeer::fillSeenRows()
{
    const auto list = _list.lock();
    const auto waiting = _unfilled;
    for (auto* item : waiting) {
        if (list && isSeen(*list, gtk_list_item_get_position(item)))
            bindRow(item);
    }
}

/// Answers the unfilled rows, the one nearest to the visible rows first.
std::vector<GtkListItem*> ListViewPeer::unfilledBesideSeen() const
{
    std::vector<GtkListItem*> items(_unfilled.begin(), _unfilled.end());
    const auto list = _list.lock();
    const auto seen = list ? list->visibleRows().first : 0;
    std::ranges::sort(items, {}, [seen](GtkListItem* item) {
        const std::size_t position = gtk_list_item_get_position(item);
        return position < seen ? seen - position : position - seen;
    });
    return items;
}

std::vector<GtkWidget*> ListViewPeer::liveRows() const
{
    std::vector<GtkWidget*> rows;
    rows.reserve(_live.size());
    for (auto* item : _live)
        rows.push_back(gtk_list_item_get_child(item));
    return rows;
}

} // namespace host::gtk
