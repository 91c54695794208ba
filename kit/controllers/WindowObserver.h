// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/Presentation.h"
#include "kit/values/TransitionToken.h"

#include <functional>
#include <string>

namespace kit {

class Window;

/// A button in a message, such as one that takes back what the message tells of.
struct NoticeAction {
    std::string title; ///< empty: the message has no button
    std::function<void()> run; ///< called once, when the button is pressed
};

/// Calls down that a window makes to the host that shows it. The model has already changed when they come.
class WindowObserver {
public:
    virtual ~WindowObserver() = default;

    virtual void rootDidChange(Window& window) = 0;
    /// The host shows the screen over the others and finishes the token when the screen is in place.
    virtual void windowWillPresent(
        Window& window, const Presentation& presentation, TransitionToken token) = 0;
    /// The host takes the screen away and finishes the token when it is gone.
    virtual void windowWillDismiss(
        Window& window, const Presentation& presentation, TransitionToken token) = 0;
    /// The host shows a short message for a few seconds, without giving it the keyboard focus. A host that
    /// has no place for messages ignores it.
    virtual void windowShowsNotice(Window&, const std::string& /*text*/, const NoticeAction&) { }
};

} // namespace kit
