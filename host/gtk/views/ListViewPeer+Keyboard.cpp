// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file handles keys in a list, beside those of the toolkit (arrows, Home, End, pages, return).

#include "host/gtk/base/MenuPopover.h"
#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"
#include "platform/Dispatch.h"
#include "platform/Services.h"

#include <algorithm>
#include <array>
#include <utility>

namespace host::gtk {

namespace {

constexpr auto noModifiers = static_cast<GdkModifierType>(0);
constexpr auto commandModifiers =
    static_cast<GdkModifierType>(GDK_CONTROL_MASK | GDK_ALT_MASK | GDK_SUPER_MASK | GDK_META_MASK);

bool isWith(GdkModifierType modifiers, GdkModifierType wanted)
{
    return (modifiers & (commandModifiers | GDK_SHIFT_MASK)) == wanted;
}

struct CommandKey {
    guint key;
    GdkModifierType modifiers;
    kit::RowCommand command;
};

constexpr CommandKey commandKeys[] = {
    {GDK_KEY_F2, noModifiers, kit::RowCommand::Rename},
    {GDK_KEY_Delete, noModifiers, kit::RowCommand::Delete},
    {GDK_KEY_KP_Delete, noModifiers, kit::RowCommand::Delete},
    {GDK_KEY_Delete, GDK_SHIFT_MASK, kit::RowCommand::DeleteForGood},
    {GDK_KEY_KP_Delete, GDK_SHIFT_MASK, kit::RowCommand::DeleteForGood},
    {GDK_KEY_Return, GDK_ALT_MASK, kit::RowCommand::Info},
    {GDK_KEY_space, noModifiers, kit::RowCommand::Peek},
    {GDK_KEY_c, GDK_CONTROL_MASK, kit::RowCommand::Copy},
};

/// Answers whether a key moves or does something, and so ends the text that is being typed.
bool endsTyping(guint key)
{
    const bool isFunction =
        (key >= GDK_KEY_BackSpace && key < GDK_KEY_Shift_L) || key == GDK_KEY_Delete || key == GDK_KEY_Menu;
    return isFunction && !g_unichar_isprint(gdk_keyval_to_unicode(key));
}

} // namespace

bool ListViewPeer::isShiftHeld() const
{
    auto* seat = gdk_display_get_default_seat(gtk_widget_get_display(_listWidget));
    auto* keyboard = seat ? gdk_seat_get_keyboard(seat) : nullptr;
    return keyboard && (gdk_device_get_modifier_state(keyboard) & GDK_SHIFT_MASK) != 0;
}

GtkWidget* ListViewPeer::focusedRow() const
{
    auto* root = gtk_widget_get_root(_listWidget);
    auto* focused = root ? gtk_root_get_focus(root) : nullptr;
    if (!focused || !gtk_widget_is_ancestor(focused, _listWidget))
        return nullptr;
    auto* row = gtk_widget_get_first_child(focused);
    return row && ListRowWidget::isRow(row) ? row : nullptr;
}

std::optional<std::size_t> ListViewPeer::focusedIndex() const
{
    auto* row = focusedRow();
    return row ? std::optional<std::size_t>(ListRowWidget::position(row)) : std::nullopt;
}

GtkWidget* ListViewPeer::rowAt(double x, double y) const
{
    auto* found = gtk_widget_pick(native(), x, y, GTK_PICK_DEFAULT);
    while (found && found != _listWidget && !ListRowWidget::isRow(found)) {
        auto* child = gtk_widget_get_first_child(found);
        if (child && ListRowWidget::isRow(child))
            return child;
        found = gtk_widget_get_parent(found);
    }
    return found && ListRowWidget::isRow(found) ? found : nullptr;
}

bool ListViewPeer::keyPressed(guint key, GdkModifierType modifiers)
{
    const auto keepsSelf = shared_from_this();
    if (endsTyping(key))
        _typeAhead.clear();
    if ((modifiers & commandModifiers) == 0 && (key == GDK_KEY_Tab || key == GDK_KEY_ISO_Left_Tab))
        return leaveByTab(key == GDK_KEY_Tab ? GTK_DIR_TAB_FORWARD : GTK_DIR_TAB_BACKWARD);
    const auto* row = focusedRow();
    if (row && rowKeyPressed(ListRowWidget::position(const_cast<GtkWidget*>(row)), key, modifiers))
        return true;
    return listKeyPressed(key, modifiers) || typedAhead(key, modifiers);
}

/// Leaves the list by Tab. The toolkit would go along the rows instead, of which there may be a hundred
/// thousand.
bool ListViewPeer::leaveByTab(GtkDirectionType direction)
{
    auto* root = gtk_widget_get_root(_listWidget);
    gtk_widget_set_can_focus(_listWidget, FALSE);
    bool hasLeft = gtk_widget_child_focus(GTK_WIDGET(root), direction);
    if (!hasLeft) {
        gtk_root_set_focus(root, nullptr);
        hasLeft = gtk_widget_child_focus(GTK_WIDGET(root), direction);
    }
    gtk_widget_set_can_focus(_listWidget, TRUE);
    return hasLeft;
}

bool ListViewPeer::canvasTakesFocus()
{
    const auto list = _list.lock();
    if (!list || !gtk_widget_get_can_focus(_listWidget))
        return false;
    const auto seen = list->visibleRows();
    const auto first = std::ranges::min_element(_live, {}, [&](GtkListItem* item) {
        const std::size_t position = gtk_list_item_get_position(item);
        return seen.contains(position) ? position : list->rowCount() + position;
    });
    auto* place = first == _live.end() ? nullptr : gtk_widget_get_parent(gtk_list_item_get_child(*first));
    return place && gtk_widget_grab_focus(place);
}

bool ListViewPeer::rowKeyPressed(std::size_t row, guint key, GdkModifierType modifiers)
{
    const auto list = _list.lock();
    if (!list)
        return false;
    if (key == GDK_KEY_Menu || (key == GDK_KEY_F10 && isWith(modifiers, GDK_SHIFT_MASK))) {
        auto* widget = focusedRow();
        showMenuOf(widget, gtk_widget_get_width(widget) / 2.0, gtk_widget_get_height(widget) / 2.0);
        return true;
    }
    if (isWith(modifiers, GDK_SHIFT_MASK) && extendByKey(row, key))
        return true;
    const bool isTyping = _typeAhead.isActive(platform::services().dispatch().now());
    if (key == GDK_KEY_space && isTyping)
        return false;
    if (key == GDK_KEY_space && list->selectionMode() == kit::SelectionMode::Multiple) {
        list->activateRow(row);
        return true;
    }
    const auto* found = std::ranges::find_if(commandKeys, [&](const CommandKey& command) {
        return command.key == key && isWith(modifiers, command.modifiers);
    });
    return found != std::end(commandKeys) && list->commandRow(row, found->command);
}

bool ListViewPeer::listKeyPressed(guint key, GdkModifierType modifiers)
{
    const auto list = _list.lock();
    if (!list)
        return false;
    if (key == GDK_KEY_F5 && list->isRefreshable() && !list->isRefreshing()) {
        list->pulledToRefresh();
        return true;
    }
    if ((key == GDK_KEY_a || key == GDK_KEY_A) && isWith(modifiers, GDK_CONTROL_MASK)) {
        list->selectAllByUser();
        return true;
    }
    return false;
}

bool ListViewPeer::extendByKey(std::size_t from, guint key)
{
    const auto list = _list.lock();
    if (!list || list->rowCount() == 0)
        return false;
    const auto page =
        static_cast<long>(std::max(1.0, gtk_widget_get_height(_listWidget) / list->rowHeight() - 1));
    const long last = static_cast<long>(list->rowCount()) - 1, here = static_cast<long>(from);
    const std::array<std::pair<guint, long>, 6> targets{
        {{GDK_KEY_Up, here - 1}, {GDK_KEY_Down, here + 1}, {GDK_KEY_Page_Up, here - page},
            {GDK_KEY_Page_Down, here + page}, {GDK_KEY_Home, 0}, {GDK_KEY_End, last}}};
    const auto* target = std::ranges::find(targets, key, &std::pair<guint, long>::first);
    if (target == targets.end())
        return false;
    const auto index = static_cast<std::size_t>(std::clamp(target->second, 0L, last));
    if (list->selection().isEmpty())
        list->extendSelectionTo(from);
    list->extendSelectionTo(index);
    list->focusRow(index);
    return true;
}

bool ListViewPeer::typedAhead(guint key, GdkModifierType modifiers)
{
    const auto list = _list.lock();
    const gunichar typed = gdk_keyval_to_unicode(key);
    if (!list || (modifiers & commandModifiers) || !g_unichar_isprint(typed))
        return false;
    const auto now = platform::services().dispatch().now();
    if (typed == ' ' && !_typeAhead.isActive(now))
        return false;
    std::array<char, 6> bytes;
    const auto length = static_cast<std::size_t>(g_unichar_to_utf8(typed, bytes.data()));
    _typeAhead.type({bytes.data(), length}, now);
    const auto focused = focusedIndex().value_or(0);
    if (const auto found = list->rowBeginningWith(_typeAhead.sought(), _typeAhead.start(focused)))
        list->focusRow(*found);
    return true;
}

} // namespace host::gtk
