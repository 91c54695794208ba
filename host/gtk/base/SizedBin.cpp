// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/SizedBin.h"

namespace host::gtk {

SizedBin::SizedBin(ResizeHandler onResize)
    : _canvas(ObjectRef<GtkWidget>::retain(CanvasWidget::make(GTK_ACCESSIBLE_ROLE_GROUP)))
    , _onResize(std::move(onResize))
{
    CanvasWidget::setClient(_canvas.get(), this);
    gtk_widget_set_hexpand(_canvas.get(), TRUE);
    gtk_widget_set_vexpand(_canvas.get(), TRUE);
}

SizedBin::~SizedBin()
{
    CanvasWidget::setClient(_canvas.get(), nullptr);
    setChild(nullptr);
}

void SizedBin::setChild(GtkWidget* child)
{
    if (_child && gtk_widget_get_parent(_child.get()) == _canvas.get())
        gtk_widget_unparent(_child.get());
    _child = ObjectRef<GtkWidget>::retain(child);
    if (child)
        CanvasWidget::insertAfter(_canvas.get(), child, nullptr);
}

platform::Size SizedBin::canvasNaturalSize(double /*forWidth*/)
{
    return {};
}

void SizedBin::canvasAllocate(int width, int height)
{
    const platform::Size size{static_cast<double>(width), static_cast<double>(height)};
    if (size != _size) {
        _size = size;
        _onResize(size);
    }
    if (_child)
        CanvasWidget::allocateChild(_child.get(), {0, 0, size.width, size.height});
}

void SizedBin::canvasSnapshot(GtkSnapshot* snapshot)
{
    CanvasWidget::snapshotChildren(_canvas.get(), snapshot);
}

bool SizedBin::canvasContains(double x, double y)
{
    return x >= 0 && y >= 0 && x < _size.width && y < _size.height;
}

} // namespace host::gtk
