// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// Answers the questions of a zoom canvas. Called on the main thread while the widget has this client.
class ZoomCanvasClient {
public:
    virtual ~ZoomCanvasClient() = default;
    virtual void zoomCanvasAllocate(int width, int height) = 0;
    virtual void zoomCanvasSnapshot(GtkSnapshot* snapshot) = 0;
    /// One of the two adjustments was replaced or has a new value.
    virtual void zoomCanvasScrolled() = 0;
};

/// A widget for a scrolled window that scrolls by drawing another part of its content. It is never larger
/// than the window, however large the content is. It takes the focus.
namespace ZoomCanvas {

GtkWidget* make(GtkAccessibleRole role);
/// Sets the client, which is not owned. The owner removes the client (null) before destroying it.
void setClient(GtkWidget* canvas, ZoomCanvasClient* client);
/// Answers null while the canvas is in no scrolled window.
GtkAdjustment* adjustment(GtkWidget* canvas, GtkOrientation orientation);

} // namespace ZoomCanvas

} // namespace host::gtk
