// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/NavigationBarPeer.h"

#include "host/gtk/base/MenuPopover.h"
#include "host/gtk/views/ButtonPeer.h"
#include "kit/controllers/NavigationItem.h"
#include "platform/Localization.h"

#include <adwaita.h>

namespace host::gtk {

namespace {

GtkWidget* makeIconButton(const char* icon, const std::string& name)
{
    auto* button = makeTouchButton();
    gtk_button_set_icon_name(GTK_BUTTON(button), icon);
    gtk_accessible_update_property(GTK_ACCESSIBLE(button), GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str(), -1);
    gtk_widget_set_tooltip_text(button, name.c_str());
    return button;
}

/// Answers a layout of the desktop's window buttons with only the close button, if the desktop has one. A
/// phone has none.
std::string closeButtonOnly()
{
    char* layout = nullptr;
    g_object_get(gtk_settings_get_default(), "gtk-decoration-layout", &layout, nullptr);
    const std::string all = layout ? layout : "";
    g_free(layout);
    const auto close = all.find("close");
    if (close == std::string::npos)
        return ":";
    return close < all.find(':') ? "close:" : ":close";
}

/// Answers whether a user could press a widget now: it is visible and nothing lies over it.
bool isInReach(GtkWidget* widget)
{
    bool takesKeys = gtk_widget_get_mapped(widget) && gtk_widget_is_sensitive(widget);
    for (auto* around = widget; around && takesKeys; around = gtk_widget_get_parent(around))
        takesKeys = around == widget || gtk_widget_get_can_focus(around);
    return takesKeys;
}

/// Adds a key that works wherever the keyboard focus is, as long as the widget is in reach.
GtkEventController* addShortcut(
    GtkWidget* widget, guint key, GdkModifierType modifiers, GtkShortcutFunc does, gpointer data = nullptr)
{
    auto* shortcuts = gtk_shortcut_controller_new();
    gtk_shortcut_controller_set_scope(GTK_SHORTCUT_CONTROLLER(shortcuts), GTK_SHORTCUT_SCOPE_GLOBAL);
    gtk_shortcut_controller_add_shortcut(GTK_SHORTCUT_CONTROLLER(shortcuts),
        gtk_shortcut_new(
            gtk_keyval_trigger_new(key, modifiers), gtk_callback_action_new(does, data, nullptr)));
    gtk_widget_add_controller(widget, shortcuts);
    return shortcuts;
}

/// Presses a button at once. The button's own activation takes a quarter of a second, in which the next keys
/// would be lost.
gboolean pressByKey(GtkWidget* button, GVariant*, gpointer)
{
    const bool isPressed = isInReach(button);
    if (isPressed)
        g_signal_emit_by_name(button, "clicked");
    return isPressed;
}

gboolean callByKey(GtkWidget* bar, GVariant*, gpointer data)
{
    // The function is copied, because it may replace the bar's own handler.
    const auto call = *static_cast<std::function<void()>*>(data);
    const bool isCalled = call && isInReach(bar);
    if (isCalled)
        call();
    return isCalled;
}

} // namespace

NavigationBarPeer::NavigationBarPeer(std::shared_ptr<PeerContext> context)
    : _context(std::move(context))
    , _bar(ObjectRef<GtkWidget>::retain(adw_header_bar_new()))
    , _title(adw_window_title_new("", ""))
    , _back(makeIconButton("go-previous-symbolic", platform::localized("Back")))
    , _search(makeIconButton("system-search-symbolic", platform::localized("Search")))
    , _menu(makeIconButton("view-more-symbolic", std::string()))
{
    auto* bar = ADW_HEADER_BAR(widget());
    adw_header_bar_set_title_widget(bar, _title);
    adw_header_bar_pack_start(bar, _back);
    adw_header_bar_pack_end(bar, _menu);
    addShortcut(_menu, GDK_KEY_F10, static_cast<GdkModifierType>(0), pressByKey);
    adw_header_bar_pack_end(bar, _search);
    addShortcut(_search, GDK_KEY_f, GDK_CONTROL_MASK, pressByKey);
    _newKey = addShortcut(widget(), GDK_KEY_n,
        static_cast<GdkModifierType>(GDK_CONTROL_MASK | GDK_SHIFT_MASK), callByKey, &_onNew);
    _connections.push_back(connectSignal<void()>(_menu, "clicked", [this] {
        if (const auto make = _makeMenu)
            showMenu(_menu, gtk_widget_get_width(_menu) / 2.0, gtk_widget_get_height(_menu), make());
    }));
    _connections.push_back(connectSignal<void()>(_back, "clicked", [this] {
        if (const auto call = _onBack)
            call();
    }));
    _connections.push_back(connectSignal<void()>(_search, "clicked", [this] {
        if (const auto call = _onSearch)
            call();
    }));
}

NavigationBarPeer::~NavigationBarPeer()
{
    _connections.clear();
    gtk_widget_remove_controller(widget(), _newKey);
    clearItems();
}

void NavigationBarPeer::show(const kit::NavigationItem& item, bool hasBackTarget)
{
    adw_window_title_set_title(ADW_WINDOW_TITLE(_title), item.title().c_str());
    adw_window_title_set_subtitle(ADW_WINDOW_TITLE(_title), item.subtitle().c_str());
    const bool replaced = !item.leftItems().empty() && !item.leftItemsSupplementBackButton();
    gtk_widget_set_visible(_back, hasBackTarget && !item.hidesBackButton() && !replaced);
    showSearch(item);
    showMenuButton(item);
    if (item.leftItems() != _left || item.rightItems() != _right)
        showItems(item);
}

void NavigationBarPeer::showSearch(const kit::NavigationItem& item)
{
    _onSearch = item.searchAction();
    _onNew = item.newAction();
    gtk_widget_set_visible(_search, static_cast<bool>(_onSearch));
}

void NavigationBarPeer::showMenuButton(const kit::NavigationItem& item)
{
    _makeMenu = item.menu();
    gtk_widget_set_visible(_menu, static_cast<bool>(_makeMenu));
    gtk_widget_set_tooltip_text(_menu, item.menuName().c_str());
    gtk_accessible_update_property(
        GTK_ACCESSIBLE(_menu), GTK_ACCESSIBLE_PROPERTY_LABEL, item.menuName().c_str(), -1);
}

void NavigationBarPeer::clearItems()
{
    for (auto& peer : std::exchange(_peers, {})) {
        adw_header_bar_remove(ADW_HEADER_BAR(widget()), peer->widget());
        _context->scheduler().release(std::move(peer));
    }
}

void NavigationBarPeer::showItems(const kit::NavigationItem& item)
{
    clearItems();
    _left = item.leftItems();
    _right = item.rightItems();
    const auto add = [this](const std::shared_ptr<kit::BarButtonItem>& entry, auto pack) {
        if (entry->isSpace())
            return;
        _peers.push_back(BarItemPeer::make(_context, entry));
        _peers.back()->setNarrow(_isNarrow);
        pack(ADW_HEADER_BAR(widget()), _peers.back()->widget());
    };
    for (const auto& entry : _left)
        add(entry, adw_header_bar_pack_start);
    for (const auto& entry : _right)
        add(entry, adw_header_bar_pack_end);
}

void NavigationBarPeer::setNarrow(bool narrow)
{
    _isNarrow = narrow;
    for (const auto& peer : _peers)
        peer->setNarrow(narrow);
    adw_header_bar_set_decoration_layout(
        ADW_HEADER_BAR(widget()), narrow ? closeButtonOnly().c_str() : nullptr);
}

void NavigationBarPeer::setWindowButtons(bool shown)
{
    adw_header_bar_set_show_start_title_buttons(ADW_HEADER_BAR(widget()), shown);
    adw_header_bar_set_show_end_title_buttons(ADW_HEADER_BAR(widget()), shown);
}

} // namespace host::gtk
