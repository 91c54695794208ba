// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileChanges.h"

#include <sys/stat.h>

#include <limits>

namespace host::system {

/// Answers a time of the kernel, a timespec or a statx_timestamp, in nanoseconds since 1970. File systems
/// have times that 64 bits cannot hold (before 1677, after 2262); such a one is the nearest that they can.
template <typename Time>
std::int64_t nanosecondsOf(const Time& time)
{
    constexpr std::int64_t perSecond = 1'000'000'000;
    constexpr auto largest = std::numeric_limits<std::int64_t>::max();
    if (time.tv_sec >= largest / perSecond)
        return largest;
    return time.tv_sec <= -largest / perSecond ? -largest
                                               : std::int64_t{time.tv_sec} * perSecond + time.tv_nsec;
}

/// Answers a time of the kernel as a date.
template <typename Time>
platform::Date dateOf(const Time& time)
{
    return {nanosecondsOf(time)};
}

/// Answers the version of an item from the kernel's status.
inline platform::ItemVersion versionOf(const struct stat& status)
{
    return {status.st_dev, status.st_ino, static_cast<std::uint64_t>(status.st_size),
        nanosecondsOf(status.st_mtim), nanosecondsOf(status.st_ctim)};
}

} // namespace host::system
