// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PreviewPeer.h"
#include "host/gtk/preview/ZoomScroller.h"
#include "screens/preview/PreviewPagesView.h"

#include <map>

namespace host::gtk {

/// Shows a document's pages one below the other, with the matches of a search and the selection.
class PagesPeer : public PreviewPeer, private ZoomContent {
public:
    explicit PagesPeer(const std::shared_ptr<screens::PreviewPagesView>& view);

    GtkWidget* widget() const override { return _scroller.widget(); }
    void start() override;
    ZoomScroller& scroller() { return _scroller; }

    void previewContentDidChange() override;
    void previewNeedsDisplay() override;
    void previewZoomDidChange() override;
    void previewShouldScrollTo(const platform::Rect& content) override;
    void previewShouldTakeFocus() override;
    void previewShouldCopy() override;

private:
    using View = screens::PreviewPagesView;
    struct Shown {
        platform::Image picture;
        ObjectRef<GdkPaintable> texture;
    };

    platform::Size baseSize(platform::Size window) override;
    void draw(GtkSnapshot* snapshot, const platform::Rect& visible) override;
    void zoomed(double zoom) override;
    void sees(const platform::Rect& visible) override;

    void drawPage(GtkSnapshot* snapshot, const View& view, std::size_t page);
    void drawPicture(
        GtkSnapshot* snapshot, std::size_t key, const platform::Image& picture, const platform::Rect& place);
    void drawMarks(GtkSnapshot* snapshot, const View& view, std::size_t page);
    void drawBroken(GtkSnapshot* snapshot, const platform::Rect& frame);
    void drawFields(GtkSnapshot* snapshot, const View& view, std::size_t page);
    void addSelection();
    void addTap();
    void addKeys();
    void addUndo();
    bool pressed(guint key, bool withControl);
    void updateLabel();

    std::weak_ptr<View> _view;
    std::map<std::size_t, Shown> _shown; ///< textures, so that a picture is not uploaded in every frame
    platform::Point _selectionStart, _pressed; ///< the former in content points, the latter in window points
    bool _isHolding = false; ///< a finger was held, and selects
    ZoomScroller _scroller;
    SignalConnections _connections;
};

} // namespace host::gtk
