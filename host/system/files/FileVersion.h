// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileChanges.h"

#include <sys/stat.h>

namespace host::system {

/// Answers a time of the kernel, a timespec or a statx_timestamp, in nanoseconds since 1970.
template <typename Time>
std::int64_t nanosecondsOf(const Time& time)
{
    return std::int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
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
