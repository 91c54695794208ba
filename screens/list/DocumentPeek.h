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

/// A look at an item without leaving the list: a small living picture of its screen above what can be done
/// with it. The return key opens it, Escape and a tap beside it put it away.
namespace DocumentPeek {

inline constexpr double miniatureHeight = 260; ///< points

/// `open` is called once the peek has closed and no longer holds the screen, which may then be shown
/// elsewhere. Present what is answered; main thread.
std::shared_ptr<kit::AlertController> make(const std::string& title,
    const std::shared_ptr<kit::ViewController>& screen, const kit::Menu& actions, std::function<void()> open);

} // namespace DocumentPeek

} // namespace screens
