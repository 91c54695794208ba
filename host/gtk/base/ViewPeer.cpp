// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/ViewPeer.h"

#include "host/gtk/base/GestureFeed.h"
#include "host/gtk/base/ThemedCanvas.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {

using kit::View;
using kit::ViewChange;
using kit::ViewChanges;
using platform::Point;
using platform::Size;
using platform::weakly;

namespace {

constexpr ViewChanges everything = ViewChange::Frame | ViewChange::Bounds | ViewChange::Subviews
    | ViewChange::Visibility | ViewChange::Style | ViewChange::Enabled | ViewChange::Content
    | ViewChange::Selection | ViewChange::Display | ViewChange::Layout | ViewChange::IntrinsicSize
    | ViewChange::Accessibility | ViewChange::Gestures;

GskRoundedRect shapeOf(const kit::ViewStyle& style, double width, double height)
{
    graphene_rect_t bounds;
    graphene_rect_init(&bounds, 0, 0, static_cast<float>(width), static_cast<float>(height));
    GskRoundedRect shape;
    gsk_rounded_rect_init_from_rect(&shape, &bounds, static_cast<float>(style.cornerRadius));
    return shape;
}

} // namespace

ViewPeer::ViewPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<View>& view, GtkAccessibleRole role)
    : _context(std::move(context))
    , _view(view)
    , _key(view.get())
    , _canvas(ObjectRef<GtkWidget>::retain(CanvasWidget::make(role)))
{
    CanvasWidget::setClient(_canvas.get(), this);
    _context->add(*view, *this);
}

ViewPeer::~ViewPeer()
{
    _context->scheduler().cancel(this);
    _context->remove(*_key, *this);
    CanvasWidget::setClient(_canvas.get(), nullptr);
    _connections.clear();
    for (const auto& child : _children)
        gtk_widget_unparent(child->widget());
    if (_native && gtk_widget_get_parent(_native.get()) == _canvas.get())
        gtk_widget_unparent(_native.get());
}

void ViewPeer::start()
{
    const auto shown = view();
    if (!shown)
        return;
    shown->setObserver(weak_from_this());
    mirror(*shown, everything);
    if (shown->isFirstResponder())
        viewWantsFocus(*shown, true);
}

void ViewPeer::setNative(GtkWidget* native)
{
    if (_native && gtk_widget_get_parent(_native.get()) == _canvas.get())
        gtk_widget_unparent(_native.get());
    _native = ObjectRef<GtkWidget>::retain(native);
    if (native)
        CanvasWidget::insertAfter(_canvas.get(), native, nullptr);
}

void ViewPeer::setRoot(ResizeHandler onResize, FittingSize fit)
{
    _onResize = std::move(onResize);
    _fit = std::move(fit);
    gtk_widget_queue_resize(_canvas.get());
}

void ViewPeer::showAnew()
{
    if (const auto shown = view())
        viewDidChange(*shown, everything);
}

void ViewPeer::viewDidChange(View&, ViewChanges changes)
{
    _pending |= changes;
    // Children are placed by their frames at the time of the allocation, so a move needs only that.
    if (changes.contains(ViewChange::Frame))
        queueAllocateInParent();
    _context->scheduler().schedule(this, [this] { mirrorPending(); });
}

void ViewPeer::queueAllocateInParent() const
{
    if (auto* parent = gtk_widget_get_parent(_canvas.get()))
        gtk_widget_queue_allocate(parent);
}

void ViewPeer::mirrorPending()
{
    const auto keepsSelf = shared_from_this();
    const ViewChanges changes = std::exchange(_pending, {});
    const auto shown = view();
    if (!shown)
        return;
    if (changes.contains(ViewChange::Layout))
        shown->layoutIfNeeded();
    mirror(*shown, changes);
}

void ViewPeer::mirror(View& shown, ViewChanges changes)
{
    if (changes.contains(ViewChange::Subviews))
        mirrorSubviews(shown);
    if (changes.contains(ViewChange::Visibility)) {
        gtk_widget_set_visible(_canvas.get(), !shown.isHidden());
        gtk_widget_set_opacity(_canvas.get(), shown.alpha());
    }
    if (changes.contains(ViewChange::Enabled)) {
        gtk_widget_set_sensitive(_canvas.get(), shown.isEnabled());
        // Assistive technology reads the state from the native widget alone.
        if (_native)
            gtk_widget_set_sensitive(_native.get(), shown.isEnabled());
    }
    if (changes.contains(ViewChange::Style) || changes.contains(ViewChange::Display))
        gtk_widget_queue_draw(_canvas.get());
    if (changes.contains(ViewChange::Accessibility))
        mirrorAccessibility(shown);
    if (changes.contains(ViewChange::Gestures))
        mirrorGestures(shown);
    if (changes.contains(ViewChange::Bounds))
        gtk_widget_queue_allocate(childContainer());
    if (_fit && (changes.contains(ViewChange::IntrinsicSize) || changes.contains(ViewChange::Layout)))
        gtk_widget_queue_resize(_canvas.get());
}

void ViewPeer::mirrorSubviews(const View& shown)
{
    auto before = std::exchange(_children, {});
    GtkWidget* previous = childContainer() == _canvas.get() ? _native.get() : nullptr;
    for (const auto& subview : shown.subviews()) {
        const auto isPeer = [&](const std::shared_ptr<ViewPeer>& peer) {
            return peer && peer->view() == subview;
        };
        const auto known = std::ranges::find_if(before, isPeer);
        const auto peer =
            known != before.end() ? std::exchange(*known, nullptr) : makePeer(_context, subview);
        CanvasWidget::insertAfter(childContainer(), peer->widget(), previous);
        previous = peer->widget();
        _children.push_back(peer);
    }
    for (auto& gone : before) {
        if (!gone)
            continue;
        gtk_widget_unparent(gone->widget());
        _context->scheduler().release(std::move(gone));
    }
    gtk_widget_queue_allocate(childContainer());
}

void ViewPeer::mirrorAccessibility(const View& shown)
{
    const auto& accessibility = shown.accessibility();
    auto* accessible = GTK_ACCESSIBLE(spoken());
    if (!accessibility.label.empty())
        gtk_accessible_update_property(
            accessible, GTK_ACCESSIBLE_PROPERTY_LABEL, accessibility.label.c_str(), -1);
    if (!accessibility.hint.empty())
        gtk_accessible_update_property(
            accessible, GTK_ACCESSIBLE_PROPERTY_DESCRIPTION, accessibility.hint.c_str(), -1);
    gtk_accessible_update_state(
        accessible, GTK_ACCESSIBLE_STATE_HIDDEN, accessibility.isHidden ? TRUE : FALSE, -1);
}

void ViewPeer::mirrorGestures(const View& shown)
{
    if (shown.gestureRecognizers().empty())
        _gestures.reset();
    else if (!_gestures)
        _gestures = std::make_unique<GestureFeed>(_canvas.get(), _view);
}

bool ViewPeer::grabFocus()
{
    return _native && gtk_widget_grab_focus(_native.get());
}

/// Drops the focus if it is still in this view, because the user may have moved it already.
void ViewPeer::dropFocus()
{
    auto* root = gtk_widget_get_root(widget());
    auto* focused = root ? gtk_root_get_focus(root) : nullptr;
    if (focused && (focused == widget() || gtk_widget_is_ancestor(focused, widget())))
        gtk_root_set_focus(root, nullptr);
}

void ViewPeer::viewWantsFocus(View&, bool focus)
{
    // This runs later, because the view may be new and its widget not in the window yet.
    _context->scheduler().schedule(&_native, weakly(this, [focus](ViewPeer& self) {
        if (focus)
            self.grabFocus();
        else
            self.dropFocus();
    }));
}

Size ViewPeer::canvasNaturalSize(double forWidth)
{
    return _fit ? _fit(forWidth) : Size();
}

void ViewPeer::canvasAllocate(int width, int height)
{
    const Size size{static_cast<double>(width), static_cast<double>(height)};
    const auto shown = view();
    if (shown && _onResize) {
        if (size != _allocated)
            _onResize(size);
        shown->layoutIfNeeded();
    }
    _allocated = size;
    if (_native)
        allocateNative(size);
    if (childContainer() == _canvas.get())
        allocateChildren();
}

/// A native widget that needs more height than its view has, such as a text field with large text, stands out
/// at both ends alike.
void ViewPeer::allocateNative(Size place)
{
    int minimum = 0;
    gtk_widget_measure(_native.get(), GTK_ORIENTATION_VERTICAL, -1, &minimum, nullptr, nullptr, nullptr);
    const double missing = std::max(0.0, minimum - place.height);
    CanvasWidget::allocateChild(_native.get(), {0, -missing / 2, place.width, place.height});
}

Point ViewPeer::childOrigin() const
{
    const auto shown = view();
    const Point origin = shown ? shown->bounds().origin() : Point();
    return {-origin.x, -origin.y};
}

void ViewPeer::allocateChildren()
{
    const Point origin = childOrigin();
    for (const auto& child : _children) {
        const auto shown = child->view();
        if (!shown)
            continue;
        const auto& frame = shown->frame();
        CanvasWidget::allocateChild(
            child->widget(), {frame.x + origin.x, frame.y + origin.y, frame.width, frame.height});
    }
}

bool ViewPeer::canvasContains(double x, double y)
{
    const auto shown = view();
    return shown && x >= 0 && y >= 0 && x < gtk_widget_get_width(_canvas.get())
        && y < gtk_widget_get_height(_canvas.get());
}

void ViewPeer::canvasSnapshot(GtkSnapshot* snapshot)
{
    const auto shown = view();
    if (!shown)
        return;
    const auto& style = shown->style();
    const auto size = paintedSize(*shown);
    const auto shape = shapeOf(style, size.width, size.height);
    snapshotBackground(*shown, snapshot, shape);
    if (style.clipsToBounds)
        gtk_snapshot_push_rounded_clip(snapshot, &shape);
    snapshotDrawing(*shown, snapshot);
    CanvasWidget::snapshotChildren(_canvas.get(), snapshot);
    if (style.clipsToBounds)
        gtk_snapshot_pop(snapshot);
    snapshotBorder(*shown, snapshot, shape);
}

/// Widgets have whole points, but a view may be thinner than a point where pixels are smaller.
Size ViewPeer::paintedSize(const View& shown) const
{
    const Size widget{static_cast<double>(gtk_widget_get_width(_canvas.get())),
        static_cast<double>(gtk_widget_get_height(_canvas.get()))};
    const auto& frame = shown.frame();
    return {std::min(widget.width, frame.width), std::min(widget.height, frame.height)};
}

void ViewPeer::snapshotBackground(const View& shown, GtkSnapshot* snapshot, const GskRoundedRect& shape)
{
    const auto& background = shown.style().background;
    if (!background || background->alpha <= 0)
        return;
    const GdkRGBA color = _context->theme().resolve(*background, ColorUse::Background);
    gtk_snapshot_push_rounded_clip(snapshot, &shape);
    gtk_snapshot_append_color(snapshot, &color, &shape.bounds);
    gtk_snapshot_pop(snapshot);
}

void ViewPeer::snapshotBorder(const View& shown, GtkSnapshot* snapshot, const GskRoundedRect& shape)
{
    const auto& style = shown.style();
    if (style.borderWidth <= 0)
        return;
    const auto width = static_cast<float>(style.borderWidth);
    const float widths[4] = {width, width, width, width};
    const GdkRGBA color = _context->theme().resolve(style.borderColor, ColorUse::Content);
    const GdkRGBA colors[4] = {color, color, color, color};
    gtk_snapshot_append_border(snapshot, &shape, widths, colors);
}

void ViewPeer::snapshotDrawing(const View& shown, GtkSnapshot* snapshot)
{
    if (!shown.drawsItself())
        return;
    graphene_rect_t bounds;
    graphene_rect_init(&bounds, 0, 0, static_cast<float>(gtk_widget_get_width(_canvas.get())),
        static_cast<float>(gtk_widget_get_height(_canvas.get())));
    auto* cairo = gtk_snapshot_append_cairo(snapshot, &bounds);
    ThemedCanvas canvas(cairo, _context->theme());
    shown.drawRect(canvas);
    cairo_destroy(cairo);
}

} // namespace host::gtk
