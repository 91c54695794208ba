// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <gtk/gtk.h>

namespace host::gtk {

/// Answers the questions of a canvas widget. Called on the main thread while the widget has this client.
class CanvasClient {
public:
    virtual ~CanvasClient() = default;
    /// Answers the size that the widget asks of its parent, in points, when it may be `forWidth` wide
    /// (negative: any width).
    virtual platform::Size canvasNaturalSize(double forWidth) = 0;
    /// The widget now has this size, and the client allocates its children.
    virtual void canvasAllocate(int width, int height) = 0;
    /// Paints the widget and its children.
    virtual void canvasSnapshot(GtkSnapshot* snapshot) = 0;
    /// Answers whether a point, in the widget's coordinates, belongs to the widget.
    virtual bool canvasContains(double x, double y) = 0;
    /// A child said that it took the keyboard focus and did not: a scrolled window says so when what it
    /// scrolls has no place for the focus. The client gives the focus to a child, and answers whether there
    /// was one.
    virtual bool canvasTakesFocus() { return false; }
};

/// A container that leaves the places of its children to its client. Without a client it is empty space. It
/// unparents its children when it is disposed of.
namespace CanvasWidget {

GType type();
GtkWidget* make(GtkAccessibleRole role);
/// Sets the client, which is not owned. The owner removes the client (null) before destroying it.
void setClient(GtkWidget* canvas, CanvasClient* client);
/// Puts a child behind `previous`, or at the very back when that is null.
void insertAfter(GtkWidget* canvas, GtkWidget* child, GtkWidget* previous);

/// Allocates a child at a rectangle, at least as large as the child's minimum size. The origin lies on a
/// device pixel, the size is rounded up to whole points, as the toolkit has no others.
void allocateChild(GtkWidget* child, const platform::Rect& frame);
void snapshotChildren(GtkWidget* canvas, GtkSnapshot* snapshot);

} // namespace CanvasWidget

} // namespace host::gtk
