// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <chrono>
#include <functional>

namespace kit {

/// Recognises one kind of touch on the view that it was added to. The peer feeds it with what one finger, or
/// the first mouse button, does; points are in the view's coordinates, times count from any fixed moment.
class GestureRecognizer {
public:
    using Time = std::chrono::milliseconds;
    using Handler = std::function<void(Point)>;

    explicit GestureRecognizer(Handler handler);
    virtual ~GestureRecognizer() = default;

    bool isEnabled() const { return _enabled; }
    void setEnabled(bool enabled);

    virtual void pressed(Point point, Time time) = 0;
    virtual void moved(Point point, Time time) = 0;
    virtual void released(Point point, Time time) = 0;
    virtual void cancelled() = 0;

protected:
    /// Calls the handler when the recogniser is enabled.
    void recognized(Point point) const;

private:
    Handler _handler;
    bool _enabled = true;
};

} // namespace kit
