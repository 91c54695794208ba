// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/DismissingTouch.h"

#include "host/gtk/base/SignalConnection.h"

#include <memory>

namespace host::gtk {

namespace {

constexpr char timeOfDismissal[] = "trw-time-of-dismissal";

/// Answers the time in milliseconds, by the clock that events use.
std::uint32_t now()
{
    return static_cast<std::uint32_t>(g_get_monotonic_time() / 1000);
}

void keepOutTouchesBefore(GtkWidget* window, std::uint32_t time)
{
    const bool isWatched = g_object_get_data(G_OBJECT(window), timeOfDismissal) != nullptr;
    g_object_set_data(G_OBJECT(window), timeOfDismissal, GUINT_TO_POINTER(time));
    if (isWatched)
        return;
    auto* events = gtk_event_controller_legacy_new();
    gtk_event_controller_set_propagation_phase(events, GTK_PHASE_CAPTURE);
    connectForLife<gboolean(GdkEvent*)>(events, "event", [window](GdkEvent* event) -> gboolean {
        const auto dismissal = GPOINTER_TO_UINT(g_object_get_data(G_OBJECT(window), timeOfDismissal));
        return gdk_event_get_event_type(event) == GDK_TOUCH_BEGIN && gdk_event_get_time(event) <= dismissal;
    });
    gtk_widget_add_controller(window, events);
}

} // namespace

void keepDismissingTouchFromWindow(GtkWidget* popover)
{
    connectForLife<void()>(popover, "closed", [popover] {
        if (auto* root = gtk_widget_get_root(popover))
            keepOutTouchesBefore(GTK_WIDGET(root), now());
    });
}

} // namespace host::gtk
