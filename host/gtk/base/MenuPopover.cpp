// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/MenuPopover.h"

#include "host/gtk/base/DismissingTouch.h"
#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"

#include <memory>

namespace host::gtk {

namespace {

constexpr int iconSize = 16;

void takeAway(GtkWidget* popover)
{
    if (gtk_widget_get_parent(popover))
        gtk_widget_unparent(popover);
}

/// Destroys a popover that has closed, but not inside its own signal.
void endLater(GtkWidget* popover)
{
    g_idle_add_once(
        [](gpointer data) {
            takeAway(GTK_WIDGET(data));
            g_object_unref(data);
        },
        g_object_ref(popover));
}

/// Gives the keyboard focus back to the widget that had it before the popover opened.
void restoreFocus(GtkWidget* popover, GtkWidget* before)
{
    auto* root = gtk_widget_get_root(popover);
    if (!root)
        return;
    const bool isStillThere = before && gtk_widget_get_root(before) == root && gtk_widget_get_mapped(before);
    gtk_root_set_focus(root, isStillThere ? before : nullptr);
}

void runLater(std::function<void()> handler)
{
    g_idle_add_once(
        [](gpointer data) {
            const std::unique_ptr<std::function<void()>> call(static_cast<std::function<void()>*>(data));
            (*call)();
        },
        new std::function<void()>(std::move(handler)));
}

GtkWidget* makeEntry(const kit::MenuAction& action)
{
    auto* content = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 12);
    if (action.mark != kit::MenuMark::None) {
        auto* check = gtk_image_new_from_icon_name("object-select-symbolic");
        gtk_widget_set_opacity(check, action.mark == kit::MenuMark::On ? 1 : 0);
        gtk_box_append(GTK_BOX(content), check);
    }
    auto* title = gtk_label_new(action.title.c_str());
    gtk_label_set_xalign(GTK_LABEL(title), 0);
    gtk_widget_set_hexpand(title, TRUE);
    gtk_box_append(GTK_BOX(content), title);
    if (action.image) {
        auto* image = gtk_image_new();
        ImagePaint::show(GTK_IMAGE(image), *action.image, iconSize);
        gtk_box_append(GTK_BOX(content), image);
    }
    auto* entry = gtk_button_new();
    gtk_button_set_child(GTK_BUTTON(entry), content);
    gtk_widget_add_css_class(entry, "flat");
    gtk_widget_add_css_class(entry, "menu-entry");
    if (action.style == kit::MenuActionStyle::Destructive)
        gtk_widget_add_css_class(entry, "destructive");
    gtk_widget_set_sensitive(entry, action.enabled);
    gtk_accessible_update_property(
        GTK_ACCESSIBLE(entry), GTK_ACCESSIBLE_PROPERTY_LABEL, action.title.c_str(), -1);
    if (action.mark != kit::MenuMark::None)
        gtk_accessible_update_state(GTK_ACCESSIBLE(entry), GTK_ACCESSIBLE_STATE_PRESSED,
            action.mark == kit::MenuMark::On ? GTK_ACCESSIBLE_TRISTATE_TRUE : GTK_ACCESSIBLE_TRISTATE_FALSE,
            -1);
    return entry;
}

/// Ends a menu together with the screen that it belongs to. A popover whose parent is no longer shown keeps
/// the grab of the pointer and the keyboard, and nobody can close it any more.
void endWithParent(GtkWidget* popover, GtkWidget* parent)
{
    auto parentLeaves = std::make_shared<SignalConnection>(connectSignal<void()>(parent, "unmap", [popover] {
        const auto keepsAlive = ObjectRef<GtkWidget>::retain(popover);
        gtk_popover_popdown(GTK_POPOVER(popover));
        takeAway(popover);
    }));
    connectForLife<void()>(popover, "closed", [parentLeaves] { parentLeaves->disconnect(); });
}

} // namespace

void showMenu(GtkWidget* parent, double x, double y, const kit::Menu& menu)
{
    if (menu.empty())
        return;
    auto* popover = gtk_popover_new();
    auto* entries = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    for (const auto& action : menu) {
        if (action.beginsSection)
            gtk_box_append(GTK_BOX(entries), gtk_separator_new(GTK_ORIENTATION_HORIZONTAL));
        auto* entry = makeEntry(action);
        connectForLife<void()>(entry, "clicked", [popover, handler = action.handler] {
            gtk_popover_popdown(GTK_POPOVER(popover));
            if (handler)
                runLater(handler);
        });
        gtk_box_append(GTK_BOX(entries), entry);
    }
    gtk_popover_set_child(GTK_POPOVER(popover), entries);
    gtk_widget_add_css_class(popover, "kit-menu");
    gtk_widget_set_parent(popover, parent);
    const GdkRectangle at{static_cast<int>(x), static_cast<int>(y), 1, 1};
    gtk_popover_set_pointing_to(GTK_POPOVER(popover), &at);
    auto* focused = gtk_root_get_focus(gtk_widget_get_root(parent));
    connectForLife<void()>(popover, "closed", [popover, before = ObjectRef<GtkWidget>::retain(focused)] {
        restoreFocus(popover, before.get());
        endLater(popover);
    });
    keepDismissingTouchFromWindow(popover);
    endWithParent(popover, parent);
    gtk_popover_popup(GTK_POPOVER(popover));
}

} // namespace host::gtk
