// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/ImagePaint.h"

#include "host/system/drawing/CairoCanvas.h"

#include <algorithm>
#include <memory>

namespace host::gtk::ImagePaint {

using platform::Image;

namespace {

constexpr int smallestIcon = 16;

ObjectRef<GtkIconPaintable> lookUp(
    const std::string& name, GdkDisplay* display, int size, int scale, GtkTextDirection direction)
{
    return ObjectRef<GtkIconPaintable>::adopt(
        gtk_icon_theme_lookup_icon(gtk_icon_theme_get_for_display(display), name.c_str(), nullptr,
            std::max(size, smallestIcon), scale, direction, static_cast<GtkIconLookupFlags>(0)));
}

void drawIcon(cairo_t* cairo, const Image& image, const platform::Rect& rect)
{
    auto* display = gdk_display_get_default();
    if (!display)
        return;
    const int side = static_cast<int>(std::max(rect.width, rect.height));
    const auto icon = lookUp(image.iconName(), display, side, 1, gtk_widget_get_default_direction());
    auto* snapshot = gtk_snapshot_new();
    gdk_paintable_snapshot(GDK_PAINTABLE(icon.get()), snapshot, rect.width, rect.height);
    if (auto* node = gtk_snapshot_free_to_node(snapshot)) {
        cairo_save(cairo);
        cairo_translate(cairo, rect.x, rect.y);
        gsk_render_node_draw(node, cairo);
        cairo_restore(cairo);
        gsk_render_node_unref(node);
    }
}

} // namespace

ObjectRef<GdkPaintable> texture(const Image& image)
{
    if (image.isNamed() || image.pixels().empty())
        return {};
    auto* bytes = g_bytes_new_with_free_func(
        image.pixels().data(), image.pixels().size() * 4,
        [](gpointer keeper) { delete static_cast<Image*>(keeper); }, new Image(image));
    auto* made = gdk_memory_texture_new(image.pixelWidth(), image.pixelHeight(), GDK_MEMORY_DEFAULT, bytes,
        static_cast<gsize>(image.pixelWidth()) * 4);
    g_bytes_unref(bytes);
    return ObjectRef<GdkPaintable>::adopt(GDK_PAINTABLE(made));
}

ObjectRef<GdkPaintable> paintable(const Image& image, GtkWidget* widget, int iconSize)
{
    if (!image.isNamed())
        return texture(image);
    const auto icon = lookUp(image.iconName(), gtk_widget_get_display(widget), iconSize,
        gtk_widget_get_scale_factor(widget), gtk_widget_get_direction(widget));
    return ObjectRef<GdkPaintable>::retain(GDK_PAINTABLE(icon.get()));
}

void show(GtkImage* widget, const Image& image, int size)
{
    gtk_image_set_pixel_size(widget, size);
    if (image.isNamed())
        gtk_image_set_from_icon_name(widget, image.iconName().c_str());
    else
        gtk_image_set_from_paintable(widget, texture(image).get());
}

void draw(cairo_t* cairo, const Image& image, const platform::Rect& rect, cairo_filter_t filter)
{
    if (rect.width <= 0 || rect.height <= 0)
        return;
    if (image.isNamed())
        drawIcon(cairo, image, rect);
    else
        system::CairoCanvas::drawPixels(cairo, image, rect, filter);
}

} // namespace host::gtk::ImagePaint
