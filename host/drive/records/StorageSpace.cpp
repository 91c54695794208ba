// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/StorageSpace.h"

#include "host/drive/records/SmallFile.h"

#include <sys/statvfs.h>

#include <algorithm>
#include <cerrno>
#include <limits>

namespace host::drive {

namespace {

// Network file systems report sizes beyond any disk, so the figures are limited to 64 bits.
std::int64_t bytes(std::uint64_t blocks, std::uint64_t blockSize)
{
    std::uint64_t result = 0;
    constexpr auto most = static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
    return __builtin_mul_overflow(blocks, blockSize, &result)
        ? static_cast<std::int64_t>(most)
        : static_cast<std::int64_t>(std::min(result, most));
}

} // namespace

platform::Result<StorageSpace> StorageSpace::of(const std::string& path)
{
    struct statvfs status { };
    int failed = 0;
    do
        failed = ::statvfs(path.c_str(), &status);
    while (failed != 0 && errno == EINTR);
    if (failed != 0)
        return itemError(errno, path);
    return StorageSpace{bytes(status.f_bavail, status.f_frsize), bytes(status.f_blocks, status.f_frsize)};
}

} // namespace host::drive
