// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/CanvasWidget.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/PeerContext.h"
#include "kit/views/View.h"

#include <functional>
#include <memory>
#include <vector>

namespace host::gtk {

class GestureFeed;

/// Shows one view of the kit with a canvas widget. The canvas paints the view's style and drawing, holds the
/// native widget of the view's class if it has one, and places the subviews' peers at the frames of the
/// model. Main thread only.
///
/// The view tells its peer of changes at once; the peer gathers them and mirrors them in the next frame,
/// before the layout. A frame that changes costs an allocation, never a new measurement. Peer and view refer
/// to each other weakly. A peer whose view is gone is destroyed when the main loop is idle, and so never
/// inside a signal of its own.
class ViewPeer : public kit::ViewObserver,
                 public CanvasClient,
                 public std::enable_shared_from_this<ViewPeer> {
public:
    ViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::View>& view,
        GtkAccessibleRole role = GTK_ACCESSIBLE_ROLE_GROUP);
    ~ViewPeer() override;
    ViewPeer(const ViewPeer&) = delete;
    ViewPeer& operator=(const ViewPeer&) = delete;

    /// Observes the view and shows all of it, with its subviews. Call it once, right after the peer was made.
    void start();

    GtkWidget* widget() const { return _canvas.get(); }
    GtkWidget* native() const { return _native.get(); } ///< null: this class has none
    std::shared_ptr<kit::View> view() const { return _view.lock(); }
    const std::vector<std::shared_ptr<ViewPeer>>& children() const { return _children; }

    /// Makes this peer the root of a place in the toolkit's own layout. `onResize` is told the size of the
    /// place and sets it in the model; `fit` answers the size that the place should ask for (null: none).
    using ResizeHandler = std::function<void(platform::Size)>;
    using FittingSize = std::function<platform::Size(double forWidth)>;
    void setRoot(ResizeHandler onResize, FittingSize fit = {});

    /// Mirrors everything again in the next frame.
    void showAnew();
    /// Moves the keyboard focus to the view. Answers false when the view does not take it.
    virtual bool grabFocus();

    void viewDidChange(kit::View& view, kit::ViewChanges changes) override;
    void viewWantsFocus(kit::View& view, bool focus) override;

    platform::Size canvasNaturalSize(double forWidth) override;
    void canvasAllocate(int width, int height) override;
    void canvasSnapshot(GtkSnapshot* snapshot) override;
    bool canvasContains(double x, double y) override;

protected:
    PeerContext& context() const { return *_context; }
    void setNative(GtkWidget* native);
    /// Answers the widget that represents the view to assistive technology.
    virtual GtkWidget* spoken() const { return _native ? _native.get() : _canvas.get(); }
    /// Answers the widget to which the subviews' widgets are added; the next one, by how much their frames
    /// are moved in it.
    virtual GtkWidget* childContainer() const { return _canvas.get(); }
    virtual platform::Point childOrigin() const;
    /// Paints what lies over the background, below the subviews and the border.
    virtual void snapshotDrawing(const kit::View& shown, GtkSnapshot* snapshot);
    /// Copies changes of the model to the widgets.
    virtual void mirror(kit::View& shown, kit::ViewChanges changes);
    void allocateChildren();
    void connect(SignalConnection connection) { _connections.push_back(std::move(connection)); }

private:
    void mirrorPending();
    void allocateNative(platform::Size place);
    void mirrorSubviews(const kit::View& shown);
    void mirrorAccessibility(const kit::View& shown);
    void mirrorGestures(const kit::View& shown);
    void dropFocus();
    void queueAllocateInParent() const;
    platform::Size paintedSize(const kit::View& shown) const;
    void snapshotBackground(const kit::View& shown, GtkSnapshot* snapshot, const GskRoundedRect& shape);
    void snapshotBorder(const kit::View& shown, GtkSnapshot* snapshot, const GskRoundedRect& shape);

    std::shared_ptr<PeerContext> _context;
    std::weak_ptr<kit::View> _view;
    const kit::View* _key;
    ObjectRef<GtkWidget> _canvas, _native;
    std::vector<std::shared_ptr<ViewPeer>> _children;
    kit::ViewChanges _pending;
    ResizeHandler _onResize;
    FittingSize _fit;
    platform::Size _allocated{-1, -1};
    std::unique_ptr<GestureFeed> _gestures;
    SignalConnections _connections;
};

/// Makes the peer for a view's class and starts it.
std::shared_ptr<ViewPeer> makePeer(
    const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::View>& view);

} // namespace host::gtk
