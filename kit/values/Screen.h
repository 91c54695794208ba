// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <optional>

namespace kit {

enum class UserInterfaceIdiom { Phone, Tablet };

/// Says how the device is held, with the numbers that layout rules use.
enum class InterfaceOrientation {
    Portrait = 1,
    PortraitUpsideDown = 2,
    LandscapeLeft = 3,
    LandscapeRight = 4,
};

/// The properties of the display that shows the application.
struct Screen {
    Rect bounds; ///< points
    double scale = 1; ///< device pixels to a point
    UserInterfaceIdiom idiom = UserInterfaceIdiom::Phone;
    Rect statusBarFrame; ///< the strip at the top that the system draws into; zero when there is none

    /// Answers the main screen, or nothing on a machine without a display. Main thread only.
    static const std::optional<Screen>& main();
    static void setMain(std::optional<Screen> screen);

    /// Answers the device pixels to a point on the main screen, and 1 without one.
    static double mainScale();

    bool operator==(const Screen&) const = default;
};

} // namespace kit
