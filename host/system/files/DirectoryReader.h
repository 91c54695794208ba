// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileSystem.h"

#include <array>
#include <cstddef>
#include <optional>
#include <string_view>

namespace host::system {

/// Reads the entries of an open folder in large pieces, "." and ".." left out, names as bytes.
class DirectoryReader {
public:
    struct Entry {
        std::string_view name; ///< zero-terminated; lives until the next call
        std::optional<platform::FileType> type; ///< nothing where the file system does not tell
    };

    /// `folder` stays open and the caller's.
    explicit DirectoryReader(const FileDescriptor& folder)
        : _descriptor(folder.get())
    {
    }
    DirectoryReader(const DirectoryReader&) = delete;
    DirectoryReader& operator=(const DirectoryReader&) = delete;

    /// The next entry; nothing at the end, and when reading failed (see error()).
    std::optional<Entry> next();
    /// Why reading ended early, if it did.
    const SystemError& error() const { return _error; }

private:
    bool fill();

    int _descriptor;
    SystemError _error;
    std::size_t _position = 0, _end = 0;
    alignas(8) std::array<char, 64 * 1024> _buffer;
};

/// The type that the file system tells of a name in an open folder, links not followed.
std::optional<platform::FileType> typeOfEntry(const FileDescriptor& folder, std::string_view name);
/// The type behind the mode bits of a stat call.
platform::FileType fileType(unsigned mode);
/// Opens a folder for reading its entries; a link is not followed.
SystemResult<FileDescriptor> openFolder(const std::string& path);
SystemResult<FileDescriptor> openFolderAt(const FileDescriptor& parent, const std::string& name);

} // namespace host::system
