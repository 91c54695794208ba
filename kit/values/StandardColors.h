// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Color.h"

namespace kit {

/// The platform's standard colours in light surroundings. A host replaces these, a white background and black
/// content by its theme's colours for the same purpose, so that they follow dark and high-contrast
/// surroundings.
namespace StandardColors {

inline constexpr Color red{0.878F, 0.106F, 0.141F, 1}; ///< error messages and destructive actions
inline constexpr Color tint{0.110F, 0.443F, 0.847F, 1}; ///< things that can be pressed
inline constexpr Color gray = Color::gray(0.5F);
inline constexpr Color lightGray = Color::gray(2.0F / 3.0F);
inline constexpr Color hairline = Color::gray(0, 0.3F); ///< the line under a navigation bar

} // namespace StandardColors

} // namespace kit
