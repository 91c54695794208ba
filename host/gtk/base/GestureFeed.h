// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/SignalConnection.h"
#include "platform/Geometry.h"

#include <gtk/gtk.h>

#include <functional>
#include <memory>

namespace kit {
class GestureRecognizer;
class View;
} // namespace kit

namespace host::gtk {

/// Reports what one finger or the first mouse button does on a widget to the recognisers of a view.
class GestureFeed {
public:
    GestureFeed(GtkWidget* widget, std::weak_ptr<kit::View> view);
    ~GestureFeed();

private:
    using Call = std::function<void(kit::GestureRecognizer&)>;
    void tell(const Call& call) const;
    void dragged(double dx, double dy);

    GtkWidget* _widget;
    GtkGesture *_drag, *_rest;
    std::weak_ptr<kit::View> _view;
    platform::Point _start, _last;
    SignalConnections _connections;
};

} // namespace host::gtk
