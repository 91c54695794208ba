// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/PopoverLayer.h"

#include "host/gtk/base/DismissingTouch.h"

#include <utility>

namespace host::gtk {

PopoverLayer::PopoverLayer(GtkWidget* parent, const GdkRectangle& anchor, GtkPositionType side,
    std::unique_ptr<LayerContent> content, std::function<void()> onOutside)
    : _content(std::move(content))
    , _popover(ObjectRef<GtkWidget>::retain(gtk_popover_new()))
{
    auto* popover = GTK_POPOVER(_popover.get());
    gtk_popover_set_child(popover, _content->widget());
    gtk_widget_add_css_class(_popover.get(), "kit-popover");
    gtk_widget_set_parent(_popover.get(), parent);
    gtk_popover_set_pointing_to(popover, &anchor);
    gtk_popover_set_position(popover, side);
    keepDismissingTouchFromWindow(_popover.get());
    _onClosed = connectSignal<void()>(popover, "closed", [this, call = std::move(onOutside)] {
        const bool byUser = std::exchange(_shown, false);
        if (const auto outside = call; byUser && outside)
            outside();
    });
}

PopoverLayer::~PopoverLayer()
{
    _onClosed.disconnect();
    gtk_popover_set_child(GTK_POPOVER(_popover.get()), nullptr);
    if (gtk_widget_get_parent(_popover.get()))
        gtk_widget_unparent(_popover.get());
}

void PopoverLayer::show(bool /*animated*/, Done done)
{
    _shown = true;
    gtk_popover_popup(GTK_POPOVER(_popover.get()));
    done();
}

void PopoverLayer::hide(bool /*animated*/, Done done)
{
    _shown = false;
    gtk_popover_popdown(GTK_POPOVER(_popover.get()));
    done();
}

void PopoverLayer::focus()
{
    _content->focus();
}

} // namespace host::gtk
