// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "platform/Geometry.h"
#include "platform/Image.h"

#include <cairo.h>
#include <gtk/gtk.h>

namespace host::gtk {

/// Shows the platform's images with the toolkit.
namespace ImagePaint {

/// Answers the pixels as a texture that keeps the image alive and copies nothing, or null for a named icon.
ObjectRef<GdkPaintable> texture(const platform::Image& image);
/// Answers the icon of a named image in a size, symbolic ones in the widget's text colour. Pixels are
/// answered as they are.
ObjectRef<GdkPaintable> paintable(const platform::Image& image, GtkWidget* widget, int iconSize);
/// Makes a GtkImage show an image in a square of `size` points.
void show(GtkImage* widget, const platform::Image& image, int size);
/// Draws an image scaled into a rectangle.
void draw(cairo_t* cairo, const platform::Image& image, const platform::Rect& rect,
    cairo_filter_t filter = CAIRO_FILTER_GOOD);

} // namespace ImagePaint

} // namespace host::gtk
