// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/Presentation.h"
#include "kit/values/TransitionToken.h"

namespace kit {

class Window;

/// Calls down that a window makes to the host that shows it. The model has changed already.
class WindowObserver {
public:
    virtual ~WindowObserver() = default;

    virtual void rootDidChange(Window& window) = 0;
    /// Show the screen over the others; finish the token when it stands.
    virtual void windowWillPresent(
        Window& window, const Presentation& presentation, TransitionToken token) = 0;
    /// Take the screen away; finish the token when it is gone.
    virtual void windowWillDismiss(
        Window& window, const Presentation& presentation, TransitionToken token) = 0;
};

} // namespace kit
