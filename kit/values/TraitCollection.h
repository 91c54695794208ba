// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

enum class SizeClass { Compact, Regular };
enum class LayoutDirection { LeftToRight, RightToLeft };
enum class ColorScheme { Light, Dark };

/// The properties of the surroundings to which a view adapts.
struct TraitCollection {
    SizeClass horizontalSizeClass = SizeClass::Compact;
    SizeClass verticalSizeClass = SizeClass::Regular;
    LayoutDirection layoutDirection = LayoutDirection::LeftToRight;
    ColorScheme colorScheme = ColorScheme::Light;
    double displayScale = 1; ///< device pixels to a point

    bool isRightToLeft() const { return layoutDirection == LayoutDirection::RightToLeft; }

    /// Answers the application's traits, which hold for every view that is in no window. Main thread only.
    static const TraitCollection& application();
    static void setApplication(const TraitCollection& traits);

    bool operator==(const TraitCollection&) const = default;
};

} // namespace kit
