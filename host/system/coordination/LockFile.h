// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/Dispatch.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace host::system {

enum class LockMode : std::uint8_t { Shared, Exclusive };

/// Locks paths for readers and writers, between threads and between processes that use the same lock file.
///
/// Every path has one byte of the file, which stays empty. The holder of a path also shares the bytes of the
/// folders above it, so a writer of a folder excludes everything below it. The locks belong to an open file
/// description of their own, so they end when it is closed, also by the kernel after a process was killed.
/// Each set is locked in the order of the bytes, which is the same for everyone, so no two sets wait for each
/// other.
class LockFile {
public:
    struct Claim {
        std::string path; ///< absolute, without "." and ".."
        LockMode mode;
    };

    /// An empty `path` means a file without a name, for this process alone. The file and its folder are made
    /// when they are missing.
    explicit LockFile(std::string path);

    /// Waits until all claims can be locked, but no longer than `patience` in all. Answers the open file that
    /// holds the locks until it is closed. Errors: EBUSY when another holder kept them all that time; all
    /// others are of the drive and not of an item (SystemError::ofDrive()), such as EROFS or EACCES when the
    /// file cannot be written.
    SystemResult<FileDescriptor> acquire(const std::vector<Claim>& claims, platform::Duration patience) const;

private:
    using Bytes = std::map<std::int64_t, LockMode>;
    static void addPath(Bytes& bytes, const Claim& claim);

    std::string _path;
    FileDescriptor _unnamed;
};

} // namespace host::system
