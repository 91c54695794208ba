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

/// Reads the entries of an open folder in large pieces, without "." and "..". Names are bytes.
class DirectoryReader {
public:
    struct Entry {
        std::string_view name; ///< zero-terminated; lives until the next call
        std::optional<platform::FileType> type; ///< absent when the file system does not say it
    };

    /// `folder` stays open and where it is, and belongs to the caller.
    explicit DirectoryReader(const FileDescriptor& folder)
        : _folder(folder)
    {
    }
    DirectoryReader(const DirectoryReader&) = delete;
    DirectoryReader& operator=(const DirectoryReader&) = delete;

    /// Answers the next entry, or nothing at the end and after an error (see error()).
    std::optional<Entry> next();
    /// Answers the error that ended the reading early, if any.
    const SystemError& error() const { return _error; }
    /// Answers the type of an entry that next() answered, or nothing when the entry is gone by now. An entry
    /// whose type cannot be found out is there, so it is FileType::Other.
    std::optional<platform::FileType> typeOf(const Entry& entry) const;

private:
    bool fill();

    const FileDescriptor& _folder;
    SystemError _error;
    std::size_t _position = 0, _end = 0;
    alignas(8) std::array<char, 64 * 1024> _buffer;
};

/// Answers the type of a name in an open folder, without following links. The error is ENOENT when the name
/// is gone; any other says nothing about that.
SystemResult<platform::FileType> typeOfEntry(const FileDescriptor& folder, std::string_view name);
/// Answers the type in the mode bits of a stat call.
platform::FileType fileType(unsigned mode);
/// Opens a folder to read its entries, without following a link.
SystemResult<FileDescriptor> openFolder(const std::string& path);
SystemResult<FileDescriptor> openFolderAt(const FileDescriptor& parent, const std::string& name);

} // namespace host::system
