// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/ToolbarPeer.h"

#include "kit/views/View.h"

#include <algorithm>

namespace host::gtk {

namespace {

constexpr int itemDistance = 6;

/// Answers whether an item has a view without a width of its own. Such a view takes the room of the flexible
/// spaces.
bool hasTakingView(const kit::BarButtonItems& items)
{
    return std::ranges::any_of(items, [](const auto& item) {
        return item->customView() && item->customView()->intrinsicContentSize().width <= 0;
    });
}

} // namespace

ToolbarPeer::ToolbarPeer(std::shared_ptr<PeerContext> context)
    : _context(std::move(context))
    , _bar(ObjectRef<GtkWidget>::retain(gtk_revealer_new()))
    , _box(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, itemDistance))
{
    // A GtkActionBar would keep three groups apart, but here the items share the whole width.
    gtk_widget_set_hexpand(_box, TRUE);
    gtk_widget_add_css_class(_box, "kit-toolbar");
    gtk_revealer_set_transition_type(GTK_REVEALER(widget()), GTK_REVEALER_TRANSITION_TYPE_SLIDE_UP);
    gtk_revealer_set_child(GTK_REVEALER(widget()), _box);
}

ToolbarPeer::~ToolbarPeer()
{
    clear();
}

void ToolbarPeer::clear()
{
    while (auto* child = gtk_widget_get_first_child(_box))
        gtk_box_remove(GTK_BOX(_box), child);
    for (auto& peer : std::exchange(_peers, {}))
        _context->scheduler().release(std::move(peer));
}

void ToolbarPeer::show(const kit::BarButtonItems& items)
{
    if (items == _items)
        return;
    clear();
    _items = items;
    const bool viewTakesAll = hasTakingView(items);
    for (const auto& item : items)
        append(item, viewTakesAll);
}

void ToolbarPeer::append(const std::shared_ptr<kit::BarButtonItem>& item, bool viewTakesAll)
{
    if (!item->isSpace()) {
        _peers.push_back(BarItemPeer::make(_context, item));
        if (GTK_IS_BUTTON(_peers.back()->widget()))
            gtk_widget_add_css_class(_peers.back()->widget(), "flat");
        gtk_box_append(GTK_BOX(_box), _peers.back()->widget());
        return;
    }
    auto* space = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0);
    if (item->systemItem() == kit::SystemItem::FixedSpace)
        gtk_widget_set_size_request(space, static_cast<int>(kit::BarButtonItem::fixedSpaceWidth), -1);
    else
        gtk_widget_set_hexpand(space, !viewTakesAll);
    gtk_box_append(GTK_BOX(_box), space);
}

void ToolbarPeer::setHidden(bool hidden)
{
    gtk_revealer_set_reveal_child(GTK_REVEALER(widget()), !hidden);
}

} // namespace host::gtk
