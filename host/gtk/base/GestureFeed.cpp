// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/GestureFeed.h"

#include "kit/views/GestureRecognizer.h"
#include "kit/views/View.h"

#include <chrono>

namespace host::gtk {

using kit::GestureRecognizer;

namespace {

GestureRecognizer::Time now()
{
    return std::chrono::duration_cast<GestureRecognizer::Time>(
        std::chrono::microseconds(g_get_monotonic_time()));
}

} // namespace

GestureFeed::GestureFeed(GtkWidget* widget, std::weak_ptr<kit::View> view)
    : _widget(widget)
    , _drag(gtk_gesture_drag_new())
    , _rest(gtk_gesture_long_press_new())
    , _view(std::move(view))
{
    gtk_widget_add_controller(widget, GTK_EVENT_CONTROLLER(_drag));
    gtk_widget_add_controller(widget, GTK_EVENT_CONTROLLER(_rest));
    _connections.push_back(
        connectSignal<void(double, double)>(_drag, "drag-begin", [this](double x, double y) {
            _start = _last = {x, y};
            tell([this](GestureRecognizer& recognizer) { recognizer.pressed(_last, now()); });
        }));
    _connections.push_back(
        connectSignal<void(double, double)>(_drag, "drag-update", [this](double x, double y) {
            dragged(x, y);
            tell([this](GestureRecognizer& recognizer) { recognizer.moved(_last, now()); });
        }));
    _connections.push_back(connectSignal<void(double, double)>(_drag, "drag-end", [this](double x, double y) {
        dragged(x, y);
        tell([this](GestureRecognizer& recognizer) { recognizer.released(_last, now()); });
    }));
    _connections.push_back(connectSignal<void(GdkEventSequence*)>(_drag, "cancel",
        [this](GdkEventSequence*) { tell([](GestureRecognizer& recognizer) { recognizer.cancelled(); }); }));
    // A finger that rests sends no events. A report without movement lets the recognisers look at the time.
    _connections.push_back(connectSignal<void(double, double)>(_rest, "pressed", [this](double, double) {
        tell([this](GestureRecognizer& recognizer) { recognizer.moved(_last, now()); });
    }));
}

GestureFeed::~GestureFeed()
{
    _connections.clear();
    gtk_widget_remove_controller(_widget, GTK_EVENT_CONTROLLER(_drag));
    gtk_widget_remove_controller(_widget, GTK_EVENT_CONTROLLER(_rest));
}

void GestureFeed::dragged(double dx, double dy)
{
    _last = {_start.x + dx, _start.y + dy};
}

void GestureFeed::tell(const Call& call) const
{
    const auto view = _view.lock();
    if (!view || !view->isEnabled())
        return;
    const auto recognizers = view->gestureRecognizers();
    for (const auto& recognizer : recognizers)
        call(*recognizer);
}

} // namespace host::gtk
