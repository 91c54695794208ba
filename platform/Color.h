// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {

/// A colour in the sRGB colour space. Each component lies between 0 and 1; the alpha is straight, so the
/// other components are not multiplied by it. Nothing checks the range: who makes a colour keeps it.
struct Color {
    float red = 0, green = 0, blue = 0, alpha = 1;

    /// A grey, from 0 for black to 1 for white.
    static constexpr Color gray(float white, float alpha = 1) { return {white, white, white, alpha}; }
    static constexpr Color white() { return gray(1); }
    static constexpr Color black() { return gray(0); }
    /// A colour that cannot be seen: its alpha is 0.
    static constexpr Color clear() { return gray(0, 0); }

    /// Two colours are equal when their components are, without any tolerance.
    bool operator==(const Color&) const = default;
};

} // namespace platform
