// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// What rows show: those that are seen at once, the others a few in each frame.

#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"

#include <algorithm>

namespace host::gtk {

namespace {

/// How many rows that nobody sees are filled in one frame, so that a frame stays a frame.
constexpr std::size_t rowsInAFrame = 6;
/// Rows beside the seen ones that are filled with them: a layout that is a little late shows no empty row.
constexpr std::size_t seenMargin = 2;

bool isSeen(const kit::ListView& list, std::size_t row)
{
    const auto visible = list.visibleRows();
    return row + seenMargin >= visible.first && row < visible.end() + seenMargin;
}

} // namespace

void ListViewPeer::bindRow(GtkListItem* item)
{
    const auto list = _list.lock();
    const guint position = gtk_list_item_get_position(item);
    _unfilled.erase(item);
    if (list && position < list->rowCount())
        ListRowWidget::show(gtk_list_item_get_child(item), list->row(position), list->rowHeight());
}

void ListViewPeer::fillSoon(GtkListItem* item)
{
    const auto list = _list.lock();
    // Between two splices of one change a place is not that of the row.
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

/// The nearest first.
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
    for (auto* item : _live)
        rows.push_back(gtk_list_item_get_child(item));
    return rows;
}

} // namespace host::gtk
