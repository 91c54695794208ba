// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Menu.h"

#include <functional>
#include <memory>
#include <string>

namespace kit {
class AlertController;
class ViewController;
} // namespace kit

namespace screens {

/// Shows an item without leaving the list: a small live picture of its screen above the item's actions. The
/// return key opens the item; Escape and a tap beside the peek close it.
namespace DocumentPeek {

inline constexpr double miniatureHeight = 260; ///< points

struct Handlers {
    /// Called once when the user opens the item, after the peek has closed and released the screen, which may
    /// then be shown elsewhere.
    std::function<void()> open;
    /// Called once after the peek has closed, however it ended, and after what was chosen in it was done.
    std::function<void()> ended;
};

/// Answers the alert to present. Main thread.
std::shared_ptr<kit::AlertController> make(const std::string& title,
    const std::shared_ptr<kit::ViewController>& screen, const kit::Menu& actions, const Handlers& handlers);

} // namespace DocumentPeek

} // namespace screens
