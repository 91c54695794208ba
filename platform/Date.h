// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <chrono>
#include <compare>
#include <cstdint>

namespace platform {

/// A moment in time, in nanoseconds since 1970-01-01 00:00 UTC (the resolution of the file system's times).
struct Date {
    std::int64_t nanoseconds = 0;

    static Date fromSeconds(double seconds) { return {static_cast<std::int64_t>(seconds * 1e9)}; }
    static Date fromTimePoint(std::chrono::system_clock::time_point time)
    {
        return {std::chrono::duration_cast<std::chrono::nanoseconds>(time.time_since_epoch()).count()};
    }

    /// Seconds since 1970, with the fraction as far as a double holds it.
    double seconds() const { return static_cast<double>(nanoseconds) / 1e9; }

    auto operator<=>(const Date&) const = default;
};

} // namespace platform
