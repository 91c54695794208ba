// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemErrors.h"
#include "platform/CloudItems.h"
#include "platform/Error.h"

#include <cstddef>
#include <string>

namespace host::drive {

/// Reads a small file whole. It refuses a link as the last name and a file larger than `limit` bytes, and
/// never waits for another program (a pipe reads as empty). Errors: FileErrorCode::NoSuchItem when there is
/// no file, CloudErrorCode::DamagedRecord for a file that is too large, else the system's.
platform::Result<std::string> readSmallFile(const std::string& path, std::size_t limit);
/// Reads a file that is already open; errors name `path`.
platform::Result<std::string> readSmallFile(
    const host::system::FileDescriptor& file, const std::string& path, std::size_t limit);

/// Answers the error of a system call on an item of the drive. It is host::system::systemError(), except that
/// an item below something that is not a folder counts as missing, and EBADMSG is
/// CloudErrorCode::DamagedRecord.
platform::Error itemError(int errorNumber, const std::string& path);
inline platform::Error itemError(const host::system::SystemError& failure, const std::string& path)
{
    return failure.concernsDrive() ? host::system::systemError(failure, path)
                                   : itemError(failure.number(), path);
}

/// The codes of errorDomain::cloud.
enum class CloudErrorCode : int {
    DamagedRecord = 1,
    OutsideDrive,
    UnknownContainer,
    UnusableBookmark,
    NotBookmarkable = platform::notBookmarkableCode,
    MissingContent
};

/// Answers the error for a record of the drive that cannot be used: of the cloud domain, with a sentence for
/// the user and, as the failure reason, the text for the log.
platform::Error damagedRecord(const std::string& path, const std::string& reason);
/// Answers an error of the cloud domain with a sentence for the user; `sentence` is looked up in the
/// catalogue.
platform::Error cloudError(CloudErrorCode code, const std::string& path, const char* sentence);
/// Answers the text of an error for the log: its failure reason, else its description.
std::string reasonOf(const platform::Error& error);

} // namespace host::drive
