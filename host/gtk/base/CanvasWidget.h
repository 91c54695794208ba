// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <gtk/gtk.h>

namespace host::gtk {

/// What a canvas widget asks. Called on the main thread while the widget has this client.
class CanvasClient {
public:
    virtual ~CanvasClient() = default;
    /// The size that the widget asks its parent for, in points, when it may be `forWidth` wide (negative:
    /// any).
    virtual platform::Size canvasNaturalSize(double forWidth) = 0;
    /// The widget has this size now: allocate its children.
    virtual void canvasAllocate(int width, int height) = 0;
    /// Paint, with the children.
    virtual void canvasSnapshot(GtkSnapshot* snapshot) = 0;
    /// Whether a point belongs to the widget. The default of a canvas is its rectangle.
    virtual bool canvasContains(double x, double y) = 0;
};

/// A container that leaves the places of its children to its client. Without one it is empty space. It
/// unparents its children when it is disposed of.
namespace CanvasWidget {

GType type();
GtkWidget* make(GtkAccessibleRole role);
/// The client is not owned: take it away before it ends.
void setClient(GtkWidget* canvas, CanvasClient* client);
/// Puts a child behind `previous`, at the very back when that is null.
void insertAfter(GtkWidget* canvas, GtkWidget* child, GtkWidget* previous);

/// Allocates a child at a rectangle on whole points, never below its minimum size.
void allocateChild(GtkWidget* child, const platform::Rect& frame);
void snapshotChildren(GtkWidget* canvas, GtkSnapshot* snapshot);

} // namespace CanvasWidget

} // namespace host::gtk
