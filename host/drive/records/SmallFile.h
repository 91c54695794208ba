// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/CloudItems.h"
#include "platform/Error.h"

#include <cstddef>
#include <string>

namespace host::drive {

/// Reads a small file whole. A link as its last name is refused, and so is a file larger than `limit` bytes;
/// it never waits for another program (a pipe reads as empty). Errors: FileErrorCode::NoSuchItem when there
/// is none, else the system's, or CloudErrorCode::DamagedRecord for a file that is too large.
platform::Result<std::string> readSmallFile(const std::string& path, std::size_t limit);
/// The same from a file that is open; `path` is named in errors.
platform::Result<std::string> readSmallFile(
    const host::system::FileDescriptor& file, const std::string& path, std::size_t limit);

/// The error of a system call on an item of the drive: as host::system::systemError(), but an item below
/// something that is no folder is missing, too.
platform::Error itemError(int errorNumber, const std::string& path);
inline platform::Error itemError(const host::system::SystemError& failure, const std::string& path)
{
    return itemError(failure.number(), path);
}

/// Codes of errorDomain::cloud.
enum class CloudErrorCode : int {
    DamagedRecord = 1,
    OutsideDrive,
    UnknownContainer,
    UnusableBookmark,
    NotBookmarkable = platform::notBookmarkableCode,
    MissingContent
};

/// A record of the drive that cannot be used: the cloud domain, with a sentence for the user and, as the
/// failure reason, what the log says of it.
platform::Error damagedRecord(const std::string& path, const std::string& reason);
/// An error of the cloud domain with a sentence for the user; `sentence` is looked up in the catalogue.
platform::Error cloudError(CloudErrorCode code, const std::string& path, const char* sentence);
/// What the log says of an error: its failure reason, else its description.
std::string reasonOf(const platform::Error& error);

} // namespace host::drive
