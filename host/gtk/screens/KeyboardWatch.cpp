// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/KeyboardWatch.h"

#include <utility>

namespace host::gtk {

namespace {

/// No keyboard is lower, and nobody drags the edge of a window so far between two frames; points.
constexpr double leastHeight = 100;

} // namespace

KeyboardWatch::Event KeyboardWatch::resized(platform::Size size, bool textHasFocus)
{
    const auto last = std::exchange(_last, size);
    if (!last || last->height == size.height)
        return Event::None;
    const double lost = last->height - size.height;
    if (_hidden && (lost <= -leastHeight || last->width != size.width)) {
        _hidden.reset();
        return Event::Disappears;
    }
    if (_hidden || !textHasFocus || last->width != size.width || lost < leastHeight)
        return Event::None;
    _hidden = lost;
    return Event::Appears;
}

} // namespace host::gtk
