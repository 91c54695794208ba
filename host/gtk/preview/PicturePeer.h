// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewPeer.h"
#include "host/gtk/preview/ZoomScroller.h"
#include "screens/preview/PreviewPictureView.h"

#include <vector>

namespace host::gtk {

/// Shows a picture in tiles, so that a large one costs only its visible part. It shows an animation frame by
/// frame.
class PicturePeer : public PreviewPeer, private ZoomContent {
public:
    explicit PicturePeer(const std::shared_ptr<screens::PreviewPictureView>& view);
    ~PicturePeer() override;

    GtkWidget* widget() const override { return _scroller.widget(); }
    void start() override;
    ZoomScroller& scroller() { return _scroller; }

    void previewContentDidChange() override;
    void previewZoomDidChange() override;
    void previewShouldStop() override;
    void previewShouldTakeFocus() override;

private:
    struct Tile {
        int x, y, width, height; ///< pixels
        ObjectRef<GdkTexture> texture; ///< made when the tile first becomes visible
    };

    platform::Size baseSize(platform::Size window) override;
    void draw(GtkSnapshot* snapshot, const platform::Rect& visible) override;
    void zoomed(double zoom) override;
    void sees(const platform::Rect& visible) override;
    void makeTiles();
    void drawTile(GtkSnapshot* snapshot, Tile& tile, double pointsPerPixel);
    void showNextFrame();
    void scheduleFrame();
    const platform::Image& frame() const { return _picture.frames[_frame].image; }

    std::weak_ptr<screens::PreviewPictureView> _view;
    platform::Picture _picture;
    std::vector<Tile> _tiles;
    platform::Size _base;
    std::size_t _frame = 0;
    guint _timer = 0;
    ZoomScroller _scroller;
    SignalConnections _connections;
};

} // namespace host::gtk
