// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/ZoomScroller.h"

#include "screens/preview/PreviewView.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace host::gtk {

using platform::Point;
using platform::Rect;
using platform::Size;
using screens::PreviewView;

namespace {

constexpr double closeLook = 2.5; ///< the zoom after a double tap
constexpr double wheelStep = 1.15;
constexpr double arrowStep = 0.1, pageStep = 0.9; ///< shares of the window

void configure(GtkAdjustment* adjustment, double value, double content, double window)
{
    const double upper = std::max(content, window);
    gtk_adjustment_configure(adjustment, std::clamp(value, 0.0, upper - window), 0, upper, window * arrowStep,
        window * pageStep, window);
}

} // namespace

ZoomScroller::ZoomScroller(ZoomContent& content, GtkAccessibleRole role, Drag drag)
    : _content(content)
    , _window(ObjectRef<GtkWidget>::retain(gtk_scrolled_window_new()))
    , _canvas(ZoomCanvas::make(role))
{
    // Pages and pictures are placed from the left in every language.
    gtk_widget_set_direction(widget(), GTK_TEXT_DIR_LTR);
    gtk_widget_set_direction(_canvas, GTK_TEXT_DIR_LTR);
    ZoomCanvas::setClient(_canvas, this);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(widget()), _canvas);
    // The canvas takes the keyboard focus, and its scrolled window does not.
    gtk_widget_set_focusable(widget(), FALSE);
    addPinch();
    addWheel();
    addDoubleTap();
    addKeys();
    if (drag == Drag::Scrolls)
        addDrag();
}

ZoomScroller::~ZoomScroller()
{
    ZoomCanvas::setClient(_canvas, nullptr);
}

void ZoomScroller::addPinch()
{
    auto* pinch = gtk_gesture_zoom_new();
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(pinch), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(widget(), GTK_EVENT_CONTROLLER(pinch));
    _connections.push_back(connectSignal<void(GdkEventSequence*)>(pinch, "begin", [this, pinch](auto*) {
        _pinchStart = _zoom;
        _pinched.reset();
        // One of the two fingers has already begun to scroll, so this gesture claims the touch.
        gtk_gesture_set_state(pinch, GTK_EVENT_SEQUENCE_CLAIMED);
    }));
    _connections.push_back(connectSignal<void(GdkEventSequence*)>(pinch, "update", [this, pinch](auto*) {
        Point center{_windowSize.width / 2, _windowSize.height / 2};
        gtk_gesture_get_bounding_box_center(pinch, &center.x, &center.y);
        // The content stays under the fingers.
        if (const auto last = std::exchange(_pinched, center)) {
            const auto seen = visible();
            scrollTo({seen.x - center.x + last->x, seen.y - center.y + last->y});
        }
        zoomAt(_pinchStart * gtk_gesture_zoom_get_scale_delta(GTK_GESTURE_ZOOM(pinch)), center);
    }));
}

void ZoomScroller::addWheel()
{
    auto* motion = gtk_event_controller_motion_new();
    gtk_widget_add_controller(widget(), motion);
    _connections.push_back(connectSignal<void(double, double)>(motion, "motion", [this](double x, double y) {
        _pointer = {x, y};
    }));
    auto* wheel = gtk_event_controller_scroll_new(GTK_EVENT_CONTROLLER_SCROLL_VERTICAL);
    gtk_event_controller_set_propagation_phase(wheel, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(widget(), wheel);
    _connections.push_back(connectSignal<gboolean(double, double)>(
        wheel, "scroll", [this, wheel](double, double steps) -> gboolean {
            const auto state = gtk_event_controller_get_current_event_state(wheel);
            if ((state & GDK_CONTROL_MASK) == 0)
                return FALSE;
            zoomAt(_zoom * std::pow(wheelStep, -steps), _pointer);
            return TRUE;
        }));
}

void ZoomScroller::addDoubleTap()
{
    auto* tap = gtk_gesture_click_new();
    gtk_widget_add_controller(_canvas, GTK_EVENT_CONTROLLER(tap));
    _connections.push_back(
        connectSignal<void(int, double, double)>(tap, "pressed", [this](int count, double x, double y) {
            gtk_widget_grab_focus(_canvas);
            if (count == 2)
                zoomAt(_zoom > 1 ? 1 : closeLook, {x, y});
        }));
}

void ZoomScroller::addDrag()
{
    auto* drag = gtk_gesture_drag_new();
    gtk_widget_add_controller(_canvas, GTK_EVENT_CONTROLLER(drag));
    _connections.push_back(connectSignal<void(double, double)>(drag, "drag-begin", [this](double, double) {
        const auto seen = visible();
        _dragStart = seen.origin();
    }));
    _connections.push_back(
        connectSignal<void(double, double)>(drag, "drag-update", [this, drag](double x, double y) {
            auto* device = gtk_gesture_get_device(GTK_GESTURE(drag));
            // The scrolled window follows a finger by itself, with its momentum.
            if (device && gdk_device_get_source(device) == GDK_SOURCE_TOUCHSCREEN)
                return;
            scrollTo({_dragStart.x - x, _dragStart.y - y});
        }));
}

void ZoomScroller::addKeys()
{
    auto* keys = gtk_event_controller_key_new();
    gtk_widget_add_controller(_canvas, keys);
    _connections.push_back(connectSignal<gboolean(guint, guint, GdkModifierType)>(
        keys, "key-pressed", [this](guint key, guint, GdkModifierType modifiers) -> gboolean {
            constexpr auto others = static_cast<GdkModifierType>(GDK_ALT_MASK | GDK_SUPER_MASK);
            return (modifiers & others) == 0 && pressed(key) ? TRUE : FALSE;
        }));
}

bool ZoomScroller::pressed(guint key)
{
    switch (key) {
    case GDK_KEY_plus:
    case GDK_KEY_equal:
    case GDK_KEY_KP_Add:
        setZoom(_zoom * PreviewView::zoomStep);
        return true;
    case GDK_KEY_minus:
    case GDK_KEY_KP_Subtract:
        setZoom(_zoom / PreviewView::zoomStep);
        return true;
    case GDK_KEY_0:
    case GDK_KEY_KP_0:
        setZoom(1);
        return true;
    case GDK_KEY_Left:
        return scrollBy(-arrowStep, 0);
    case GDK_KEY_Right:
        return scrollBy(arrowStep, 0);
    case GDK_KEY_Up:
        return scrollBy(0, -arrowStep);
    case GDK_KEY_Down:
        return scrollBy(0, arrowStep);
    case GDK_KEY_Page_Up:
        return scrollBy(0, -pageStep);
    case GDK_KEY_Page_Down:
    case GDK_KEY_space:
        return scrollBy(0, pageStep);
    case GDK_KEY_Home:
        scrollTo({visible().x, 0});
        return true;
    case GDK_KEY_End:
        scrollTo({visible().x, contentSize().height});
        return true;
    default:
        return false;
    }
}

bool ZoomScroller::scrollBy(double pagesX, double pagesY)
{
    const auto seen = visible();
    scrollTo({seen.x + pagesX * _windowSize.width, seen.y + pagesY * _windowSize.height});
    return true;
}

Point ZoomScroller::margin() const
{
    const auto size = contentSize();
    return {std::max(0.0, std::floor((_windowSize.width - size.width) / 2)),
        std::max(0.0, std::floor((_windowSize.height - size.height) / 2))};
}

Rect ZoomScroller::visible() const
{
    if (!horizontal() || !vertical())
        return {};
    const auto outside = margin();
    return {gtk_adjustment_get_value(horizontal()) - outside.x,
        gtk_adjustment_get_value(vertical()) - outside.y, _windowSize.width, _windowSize.height};
}

Point ZoomScroller::toContent(Point window) const
{
    const auto seen = visible();
    return {seen.x + window.x, seen.y + window.y};
}

void ZoomScroller::setZoom(double zoom)
{
    zoomAt(zoom, {_windowSize.width / 2, _windowSize.height / 2});
}

void ZoomScroller::zoomAt(double zoom, Point window)
{
    const double wanted = std::clamp(zoom, PreviewView::minZoom, PreviewView::maxZoom);
    if (wanted == _zoom)
        return;
    const auto fixed = toContent(window);
    const double growth = wanted / std::exchange(_zoom, wanted);
    _content.zoomed(_zoom);
    place({fixed.x * growth - window.x, fixed.y * growth - window.y});
    gtk_widget_queue_draw(_canvas);
}

void ZoomScroller::place(Point wanted)
{
    if (!horizontal() || !vertical() || _windowSize.width <= 0)
        return;
    const auto outside = margin();
    const auto size = contentSize();
    _isPlacing = true;
    configure(horizontal(), wanted.x + outside.x, size.width, _windowSize.width);
    configure(vertical(), wanted.y + outside.y, size.height, _windowSize.height);
    _isPlacing = false;
    tellWhatIsSeen();
}

void ZoomScroller::scrollTo(Point content)
{
    if (_windowSize.width <= 0) {
        _wanted = content;
        return;
    }
    place(content);
    gtk_widget_queue_draw(_canvas);
}

void ZoomScroller::contentDidChange()
{
    if (_windowSize.width > 0) {
        const auto seen = visible();
        _base = _content.baseSize(_windowSize);
        place(seen.origin());
    }
    gtk_widget_queue_draw(_canvas);
}

void ZoomScroller::zoomCanvasAllocate(int width, int height)
{
    const auto seen = visible();
    const Size window{static_cast<double>(width), static_cast<double>(height)};
    const bool isFirst = _windowSize.width <= 0;
    const auto before = std::exchange(_base, _content.baseSize(window));
    _windowSize = window;
    if (isFirst)
        return place(std::exchange(_wanted, std::nullopt).value_or(Point{}));
    // In a window of another size the same part of the content stays in the corner.
    const auto moved = [](double at, double from, double to) { return from > 0 ? at * to / from : 0; };
    place({moved(seen.x, before.width, _base.width), moved(seen.y, before.height, _base.height)});
}

void ZoomScroller::zoomCanvasSnapshot(GtkSnapshot* snapshot)
{
    const auto seen = visible();
    // The origin lies on whole device pixels, so that content that is aligned to it stays sharp and without
    // seams.
    const double scale = gtk_widget_get_scale_factor(_canvas);
    const auto whole = [scale](
                           double points) { return static_cast<float>(std::round(points * scale) / scale); };
    graphene_point_t origin;
    graphene_point_init(&origin, whole(-seen.x), whole(-seen.y));
    gtk_snapshot_translate(snapshot, &origin);
    _content.draw(snapshot, seen);
}

void ZoomScroller::zoomCanvasScrolled()
{
    if (!_isPlacing)
        tellWhatIsSeen();
}

void ZoomScroller::tellWhatIsSeen()
{
    if (_windowSize.width > 0)
        _content.sees(visible());
}

} // namespace host::gtk
