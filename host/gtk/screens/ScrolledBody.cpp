// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/ScrolledBody.h"

#include <adwaita.h>

#include <algorithm>

namespace host::gtk {

namespace {

GtkWidget* bodyOf(GtkWidget* bin)
{
    auto* viewport = gtk_scrolled_window_get_child(GTK_SCROLLED_WINDOW(adw_bin_get_child(ADW_BIN(bin))));
    return gtk_viewport_get_child(GTK_VIEWPORT(viewport));
}

GtkSizeRequestMode heightForWidth(GtkWidget*)
{
    return GTK_SIZE_REQUEST_HEIGHT_FOR_WIDTH;
}

void measure(GtkWidget* bin, GtkOrientation orientation, int forSize, int* minimum, int* natural,
    int* minimumBaseline, int* naturalBaseline)
{
    gtk_widget_measure(bodyOf(bin), orientation, forSize, minimum, natural, nullptr, nullptr);
    *minimumBaseline = *naturalBaseline = -1;
    if (orientation == GTK_ORIENTATION_VERTICAL)
        gtk_widget_measure(
            adw_bin_get_child(ADW_BIN(bin)), orientation, forSize, minimum, nullptr, nullptr, nullptr);
    *natural = std::max(*natural, *minimum);
}

void allocate(GtkWidget* bin, int width, int height, int baseline)
{
    gtk_widget_allocate(adw_bin_get_child(ADW_BIN(bin)), width, height, baseline, nullptr);
}

} // namespace

GtkWidget* makeScrolledBody(GtkWidget* body)
{
    auto* window = gtk_scrolled_window_new();
    // The body takes the keyboard focus, and its scrolled window does not.
    gtk_widget_set_focusable(window, FALSE);
    gtk_scrolled_window_set_policy(GTK_SCROLLED_WINDOW(window), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(window), body);
    auto* bin = adw_bin_new();
    adw_bin_set_child(ADW_BIN(bin), window);
    gtk_widget_set_layout_manager(bin, gtk_custom_layout_new(heightForWidth, measure, allocate));
    return bin;
}

} // namespace host::gtk
