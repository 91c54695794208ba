// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <optional>

namespace host::gtk {

/// Tells from the sizes of a window whether a keyboard is on the screen. No protocol says so to a program:
/// the compositor of a phone takes the keyboard's room from the window, in one step, while a text has the
/// focus.
class KeyboardWatch {
public:
    enum class Event { None, Appears, Disappears };

    /// The window has another size; points. Answers what that means.
    Event resized(platform::Size size, bool textHasFocus);
    /// Answers the room that the keyboard has taken from the window; points. 0 without a keyboard.
    double height() const { return _hidden ? *_hidden : 0; }

private:
    std::optional<platform::Size> _last;
    std::optional<double> _hidden;
};

} // namespace host::gtk
