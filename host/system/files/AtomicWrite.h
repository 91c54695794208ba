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

/// Writes a file so that at every moment, a crash and a full disk included, its name holds the old content or
/// the new: a temporary file in the same folder, synced, renamed over the name, the folder synced. What was
/// under the name is replaced. A new file can be read by the user alone; one that was there keeps its mode.
/// Answers why it failed, the old content then being untouched. Any thread; waits for the disk.
std::optional<platform::Error> writeFileAtomically(const std::string& path, std::string_view content);

/// The same for a name in an open folder; `path` is only for the error.
std::optional<platform::Error> writeFileAtomically(
    const FileDescriptor& folder, const std::string& name, std::string_view content, std::string_view path);

/// Writes a file that is new, whole or not at all: what has the name already stays
/// (FileErrorCode::ItemExists). It is for what can be made again, because it does not wait for the disk.
std::optional<platform::Error> writeNewFileAtomically(const std::string& path, std::string_view content);

/// The steps of such a write, for those who take them one by one.
SystemError writeWhole(const FileDescriptor& file, std::string_view content);
/// Brings a folder's names to the disk; a descriptor opened with O_PATH will do.
SystemError syncFolder(const FileDescriptor& folder);
/// A name that nothing has yet in any folder: a prefix, the process, the time, a number.
std::string uniqueName(std::string_view prefix);

/// A whole file of at most `maximumBytes` (EFBIG otherwise). Nothing but regular files is opened, and no link
/// followed (ELOOP).
platform::Result<std::string> readWholeFile(const std::string& path, std::size_t maximumBytes);
platform::Result<std::string> readWholeFile(
    const FileDescriptor& folder, const std::string& name, std::size_t maximumBytes, std::string_view path);

} // namespace host::system
