// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {

/// A colour in sRGB, straight (not premultiplied) alpha, each component in 0 to 1.
struct Color {
    float red = 0, green = 0, blue = 0, alpha = 1;

    static constexpr Color gray(float white, float alpha = 1) { return {white, white, white, alpha}; }
    static constexpr Color white() { return gray(1); }
    static constexpr Color black() { return gray(0); }
    static constexpr Color clear() { return gray(0, 0); }

    bool operator==(const Color&) const = default;
};

} // namespace platform
