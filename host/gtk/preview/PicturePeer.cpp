// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PicturePeer.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace host::gtk {

using platform::Image;
using platform::Rect;
using platform::Size;
using screens::PreviewPictureView;

namespace {

constexpr int tileSide = 1024; ///< pixels

/// Answers the pixels of a part of an image. They keep the image alive.
ObjectRef<GdkTexture> partTexture(const Image& image, int x, int y, int width, int height)
{
    const auto stride = static_cast<std::size_t>(image.pixelWidth());
    const auto first = static_cast<std::size_t>(y) * stride + static_cast<std::size_t>(x);
    const auto count = static_cast<std::size_t>(height - 1) * stride + static_cast<std::size_t>(width);
    auto* bytes = g_bytes_new_with_free_func(
        image.pixels().data() + first, count * 4, [](gpointer keeper) { delete static_cast<Image*>(keeper); },
        new Image(image));
    auto* made = gdk_memory_texture_new(width, height, GDK_MEMORY_DEFAULT, bytes, stride * 4);
    g_bytes_unref(bytes);
    return ObjectRef<GdkTexture>::adopt(made);
}

} // namespace

PicturePeer::PicturePeer(const std::shared_ptr<PreviewPictureView>& view)
    : _view(view)
    , _scroller(*this, GTK_ACCESSIBLE_ROLE_IMG, ZoomScroller::Drag::Scrolls)
{
}

PicturePeer::~PicturePeer()
{
    previewShouldStop();
}

void PicturePeer::start()
{
    addShortcuts(widget(), _view);
    // An animation runs only while the widget is visible.
    _connections.push_back(connectSignal<void()>(widget(), "map", [this] {
        gtk_widget_grab_focus(_scroller.canvas());
        scheduleFrame();
    }));
    _connections.push_back(connectSignal<void()>(widget(), "unmap", [this] { previewShouldStop(); }));
    previewContentDidChange();
    previewZoomDidChange();
}

void PicturePeer::previewContentDidChange()
{
    const auto view = _view.lock();
    if (!view)
        return;
    _picture = view->picture();
    _frame = 0;
    makeTiles();
    if (!view->accessibility().label.empty())
        gtk_accessible_update_property(GTK_ACCESSIBLE(_scroller.canvas()), GTK_ACCESSIBLE_PROPERTY_LABEL,
            view->accessibility().label.c_str(), -1);
    _scroller.contentDidChange();
    scheduleFrame();
}

void PicturePeer::makeTiles()
{
    _tiles.clear();
    if (_picture.frames.empty())
        return;
    const int width = frame().pixelWidth(), height = frame().pixelHeight();
    for (int y = 0; y < height; y += tileSide) {
        for (int x = 0; x < width; x += tileSide)
            _tiles.push_back({x, y, std::min(tileSide, width - x), std::min(tileSide, height - y), {}});
    }
}

Size PicturePeer::baseSize(Size window)
{
    if (_picture.frames.empty())
        return _base = {};
    // The window shows the whole picture, but a picture with few pixels is not enlarged.
    const double scale = std::max(1.0, frame().scale());
    const double width = std::max(_picture.sourceWidth, 1) / scale;
    const double height = std::max(_picture.sourceHeight, 1) / scale;
    const double fit = std::min({1.0, window.width / width, window.height / height});
    return _base = {width * fit, height * fit};
}

void PicturePeer::draw(GtkSnapshot* snapshot, const Rect& visible)
{
    if (_picture.frames.empty() || _base.width <= 0)
        return;
    const double pointsPerPixel = _base.width * _scroller.zoom() / frame().pixelWidth();
    for (auto& tile : _tiles) {
        const bool isSeen = tile.x * pointsPerPixel < visible.maxX()
            && (tile.x + tile.width) * pointsPerPixel > visible.x && tile.y * pointsPerPixel < visible.maxY()
            && (tile.y + tile.height) * pointsPerPixel > visible.y;
        if (isSeen)
            drawTile(snapshot, tile, pointsPerPixel);
    }
}

void PicturePeer::drawTile(GtkSnapshot* snapshot, Tile& tile, double pointsPerPixel)
{
    if (!tile.texture)
        tile.texture = partTexture(frame(), tile.x, tile.y, tile.width, tile.height);
    // Tiles end on whole device pixels, so that no seam shows between two of them.
    const double scale = gtk_widget_get_scale_factor(widget());
    const auto edge = [&](int pixel) { return std::round(pixel * pointsPerPixel * scale) / scale; };
    const double left = edge(tile.x), top = edge(tile.y);
    graphene_rect_t place;
    graphene_rect_init(&place, static_cast<float>(left), static_cast<float>(top),
        static_cast<float>(edge(tile.x + tile.width) - left),
        static_cast<float>(edge(tile.y + tile.height) - top));
    gtk_snapshot_append_texture(snapshot, tile.texture.get(), &place);
}

void PicturePeer::zoomed(double zoom)
{
    const auto view = _view.lock();
    if (!view)
        return;
    view->userZoomed(zoom);
    view->userSeesPixels(_base.width * zoom * gtk_widget_get_scale_factor(widget()));
}

void PicturePeer::sees(const Rect&) { }

void PicturePeer::previewZoomDidChange()
{
    if (const auto view = _view.lock())
        _scroller.setZoom(view->zoom());
}

void PicturePeer::previewShouldStop()
{
    if (_timer != 0)
        g_source_remove(std::exchange(_timer, 0));
}

void PicturePeer::previewShouldTakeFocus()
{
    gtk_widget_grab_focus(_scroller.canvas());
}

void PicturePeer::scheduleFrame()
{
    previewShouldStop();
    if (_picture.frames.size() < 2 || !gtk_widget_get_mapped(widget()))
        return;
    _timer = g_timeout_add(
        static_cast<guint>(_picture.frames[_frame].milliseconds),
        [](gpointer self) -> gboolean {
            static_cast<PicturePeer*>(self)->showNextFrame();
            return G_SOURCE_REMOVE;
        },
        this);
}

void PicturePeer::showNextFrame()
{
    _timer = 0;
    _frame = (_frame + 1) % _picture.frames.size();
    makeTiles();
    gtk_widget_queue_draw(_scroller.canvas());
    scheduleFrame();
}

} // namespace host::gtk
