// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <chrono>
#include <compare>
#include <cstdint>

namespace platform {

/// A moment in time, counted in nanoseconds since 1970-01-01 00:00 UTC, because that is the resolution of the
/// file system's times. It reaches from 1677 to 2262; a time before 1970 is negative.
struct Date {
    std::int64_t nanoseconds = 0;

    /// The moment so many seconds after 1970. A double has the precision of a microsecond there, no more.
    static Date fromSeconds(double seconds) { return {static_cast<std::int64_t>(seconds * 1e9)}; }
    /// The moment of the system's clock.
    static Date fromTimePoint(std::chrono::system_clock::time_point time)
    {
        return {std::chrono::duration_cast<std::chrono::nanoseconds>(time.time_since_epoch()).count()};
    }

    /// The seconds since 1970, with the fraction as far as a double holds it (about a microsecond).
    double seconds() const { return static_cast<double>(nanoseconds) / 1e9; }

    auto operator<=>(const Date&) const = default;
};

} // namespace platform
