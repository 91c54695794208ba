// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/SignalConnection.h"
#include "host/gtk/preview/ZoomCanvas.h"
#include "platform/Geometry.h"

#include <gtk/gtk.h>

#include <memory>
#include <optional>

namespace host::gtk {

/// The content of a zoom scroller. Its size at a zoom of 1 depends only on the window, and everything grows
/// with the zoom. Lengths are points.
class ZoomContent {
public:
    virtual ~ZoomContent() = default;
    /// Answers the size at a zoom of 1 in a window of this size.
    virtual platform::Size baseSize(platform::Size window) = 0;
    /// Draws the part of the content in `visible`. The origin is that of the content.
    virtual void draw(GtkSnapshot* snapshot, const platform::Rect& visible) = 0;
    /// Called when the zoom changes, before the content is laid out and drawn.
    virtual void zoomed(double zoom) = 0;
    /// Called when another part of the content becomes visible.
    virtual void sees(const platform::Rect& visible) = 0;
};

/// Scrolls and zooms content by pinching, double tap, Ctrl with the wheel, and keys. Main thread only.
class ZoomScroller : public ZoomCanvasClient {
public:
    enum class Drag { Scrolls, IsForContent }; ///< what the mouse's drag does; a finger always scrolls

    ZoomScroller(ZoomContent& content, GtkAccessibleRole role, Drag drag);
    ~ZoomScroller() override;
    ZoomScroller(const ZoomScroller&) = delete;
    ZoomScroller& operator=(const ZoomScroller&) = delete;

    GtkWidget* widget() const { return _window.get(); } ///< the scrolled window
    GtkWidget* canvas() const { return _canvas; }

    double zoom() const { return _zoom; }
    void setZoom(double zoom); ///< keeps the middle of the window in place
    /// The content has another size or look.
    void contentDidChange();
    void scrollTo(platform::Point content); ///< brings a place to the top left corner as far as possible
    platform::Rect visible() const; ///< content points
    platform::Point toContent(platform::Point window) const;

    void zoomCanvasAllocate(int width, int height) override;
    void zoomCanvasSnapshot(GtkSnapshot* snapshot) override;
    void zoomCanvasScrolled() override;

private:
    void addPinch();
    void addWheel();
    void addDoubleTap();
    void addDrag();
    void addKeys();
    bool pressed(guint key);
    bool scrollBy(double pagesX, double pagesY);
    void zoomAt(double zoom, platform::Point window);
    void place(platform::Point wanted); ///< moves the content's point to the window's corner
    platform::Size contentSize() const { return {_base.width * _zoom, _base.height * _zoom}; }
    platform::Point margin() const; ///< empty space around content that is smaller than the window
    GtkAdjustment* horizontal() const { return ZoomCanvas::adjustment(_canvas, GTK_ORIENTATION_HORIZONTAL); }
    GtkAdjustment* vertical() const { return ZoomCanvas::adjustment(_canvas, GTK_ORIENTATION_VERTICAL); }
    void tellWhatIsSeen();

    ZoomContent& _content;
    ObjectRef<GtkWidget> _window;
    GtkWidget* _canvas;
    platform::Size _windowSize, _base;
    double _zoom = 1, _pinchStart = 1;
    platform::Point _dragStart, _pointer;
    std::optional<platform::Point> _pinched; ///< the middle between the two fingers
    bool _isPlacing = false;
    std::optional<platform::Point> _wanted; ///< the place to go to when there is a window
    SignalConnections _connections;
};

} // namespace host::gtk
