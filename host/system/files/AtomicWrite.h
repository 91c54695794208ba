// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// Writes a file so that at every moment, even in a crash or on a full disk, its name stands for the old
/// content or the new one: it writes a temporary file in the same folder, syncs it, renames it over the name
/// and syncs the folder. An existing file is replaced and its mode is kept; a new file can be read by the
/// user alone. Answers the error; the old content is then untouched. Any thread; it waits for the disk.
std::optional<platform::Error> writeFileAtomically(const std::string& path, std::string_view content);

/// Writes a name in an open folder.
SystemError writeFileAtomically(
    const FileDescriptor& folder, const std::string& name, std::string_view content);

/// Writes a new file, whole or not at all. It never replaces a file (FileErrorCode::ItemExists). It is for
/// content that could be made again, because it does not wait for the disk.
std::optional<platform::Error> writeNewFileAtomically(const std::string& path, std::string_view content);

/// These are the steps of such a write, for callers that take them one by one.
SystemError writeWhole(const FileDescriptor& file, std::string_view content);
/// Syncs a folder, so that its names survive a power cut. The descriptor may be opened with O_PATH.
SystemError syncFolder(const FileDescriptor& folder);
/// Answers a name that no folder has yet: a prefix, the process, the time and a number.
std::string uniqueName(std::string_view prefix);

/// Reads a whole file of at most `maximumBytes` (else EFBIG). It opens only regular files and follows no link
/// (ELOOP).
platform::Result<std::string> readWholeFile(const std::string& path, std::size_t maximumBytes);
SystemResult<std::string> readWholeFile(
    const FileDescriptor& folder, const std::string& name, std::size_t maximumBytes);

} // namespace host::system
