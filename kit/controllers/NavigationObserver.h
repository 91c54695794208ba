// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/TransitionToken.h"

#include <memory>

namespace kit {

class NavigationController;
class ViewController;

enum class NavigationKind { Push, Pop, Replace };

/// A change of the screen that a navigation controller shows.
struct NavigationTransition {
    NavigationKind kind;
    std::shared_ptr<ViewController> from; ///< null: nothing was shown
    std::shared_ptr<ViewController> to; ///< null: the stack is empty
    bool animated;
};

/// Calls down that only a navigation controller makes. The stack has already changed when they come.
class NavigationObserver {
public:
    virtual ~NavigationObserver() = default;

    /// The observer shows the other screen and finishes the token when the movement has ended. A transition
    /// that is not finished when the next one begins counts as finished.
    virtual void navigationWillTransition(
        NavigationController& controller, const NavigationTransition& transition, TransitionToken token) = 0;
    /// The stack changed below the screen on top.
    virtual void stackDidChange(NavigationController& controller) = 0;
    virtual void toolbarVisibilityDidChange(NavigationController& controller, bool animated) = 0;
};

} // namespace kit
