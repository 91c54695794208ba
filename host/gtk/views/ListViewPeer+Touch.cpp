// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file handles touches in a list, beside the scrolling and tapping of the toolkit.

#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"
#include "platform/Dispatch.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <cmath>

namespace host::gtk {
using platform::Point;
using platform::weakly;

namespace {

constexpr double markDragStart = 8; ///< points; a tap moves less
constexpr double strayed = 24; ///< points; a touch that moved so far opens no row
constexpr platform::Duration pressOn =
    std::chrono::milliseconds(1200); ///< after the row was recognised as held

} // namespace

/// Keeps a touch that leaves its starting place from opening a row, even when no gesture follows it, and two
/// touches at once as well.
void ListViewPeer::connectStrayingFinger()
{
    auto* events = gtk_event_controller_legacy_new();
    gtk_event_controller_set_propagation_phase(events, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(native(), events);
    connect(connectSignal<gboolean(GdkEvent*)>(events, "event", [this](GdkEvent* event) -> gboolean {
        followFinger(event);
        return FALSE;
    }));
}

void ListViewPeer::followFinger(GdkEvent* event)
{
    const auto type = gdk_event_get_event_type(event);
    if (type < GDK_TOUCH_BEGIN || type > GDK_TOUCH_CANCEL)
        return;
    const bool isFirst = gdk_touch_event_get_emulating_pointer(event) != FALSE;
    Point place;
    gdk_event_get_position(event, &place.x, &place.y);
    if (type == GDK_TOUCH_BEGIN && isFirst) {
        _fingers = 0;
        _fingerStart = place;
        _hasStrayed = false;
    }
    if (type == GDK_TOUCH_BEGIN)
        ++_fingers;
    const bool isAway = std::hypot(place.x - _fingerStart.x, place.y - _fingerStart.y) >= strayed;
    _hasStrayed |= _fingers > 1 || (isFirst && isAway);
    const bool hasLeft = type == GDK_TOUCH_END || type == GDK_TOUCH_CANCEL;
    // The flag is reset in the next frame, because the row receives the end of the touch after this, and a
    // key may activate the row later.
    if (hasLeft && --_fingers <= 0)
        context().scheduler().scheduleNextFrame(&_hasStrayed, [this] { _hasStrayed = false; });
}

/// Dragging along the check marks selects or deselects all rows on the way.
void ListViewPeer::connectMarks()
{
    auto* drag = gtk_gesture_drag_new();
    // The gesture is on the widget around the scrolled window, because the scrolled window would take the
    // touch.
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(drag), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(native(), GTK_EVENT_CONTROLLER(drag));
    connect(connectSignal<void(double, double)>(drag, "drag-begin", [this, drag](double x, double y) {
        auto* row = rowAt(x, y);
        double rowX = 0, rowY = 0;
        if (row)
            gtk_widget_translate_coordinates(native(), row, x, y, &rowX, &rowY);
        const bool isMark = row && !isShiftHeld() && ListRowWidget::isOnMark(row, rowX);
        gtk_gesture_set_state(drag, isMark ? GTK_EVENT_SEQUENCE_CLAIMED : GTK_EVENT_SEQUENCE_DENIED);
        if (const auto list = _list.lock(); list && isMark)
            list->activateRow(ListRowWidget::position(row));
    }));
    connect(connectSignal<void(double, double)>(drag, "drag-update", [this, drag](double x, double y) {
        double startX = 0, startY = 0;
        gtk_gesture_drag_get_start_point(GTK_GESTURE_DRAG(drag), &startX, &startY);
        auto* row = rowAt(startX, startY + y);
        const auto list = _list.lock();
        const bool hasMoved = std::hypot(x, y) >= markDragStart;
        if (list && row && hasMoved && list->selectionMode() == kit::SelectionMode::Multiple)
            list->extendSelectionTo(ListRowWidget::position(row));
    }));
}

/// Makes a list follow a finger even when all rows are visible. The toolkit would not, and the list could not
/// be pulled to refresh.
void ListViewPeer::followFingerEvenIfAllIsSeen()
{
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    const bool isAllSeen = gtk_adjustment_get_upper(adjustment) <= gtk_adjustment_get_page_size(adjustment);
    const auto list = _list.lock();
    const bool follows = isAllSeen && list && list->isRefreshable();
    gtk_scrolled_window_set_policy(
        GTK_SCROLLED_WINDOW(_window), GTK_POLICY_NEVER, follows ? GTK_POLICY_EXTERNAL : GTK_POLICY_AUTOMATIC);
}

void ListViewPeer::held(GtkWidget* row, double x, double y)
{
    const auto list = _list.lock();
    if (list && !_hasStrayed && !list->holdRow(ListRowWidget::position(row)))
        showMenuOf(row, x, y);
}

/// Opens the held row when the finger stays on it after its preview appeared.
void ListViewPeer::waitForPressOn()
{
    auto& dispatch = platform::services().dispatch();
    dispatch.after(pressOn, dispatch.mainQueue(), weakly(this, [hold = ++_holds](ListViewPeer& self) {
        const auto held = self._list.lock();
        if (held && self._holds == hold)
            held->pressOnHeldRow();
    }));
}

} // namespace host::gtk
