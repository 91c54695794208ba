// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace kit {

class ViewController;

/// Says how a presented screen lies over the one below, with the platform's numbers. Only FullScreen makes
/// the screen below disappear.
enum class PresentationStyle { FullScreen = 0, PageSheet = 1, OverCurrentContext = 6, Popover = 7 };

/// One screen over another.
struct Presentation {
    std::shared_ptr<ViewController> presented;
    std::shared_ptr<ViewController> presenting;
    bool animated = false;
};

} // namespace kit
