// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/DocumentIndex.h"
#include "host/drive/records/DriveLayout.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/DocumentIdentifiers.h"

#include <sys/stat.h>

namespace host::drive {

/// An item or its promise, held open while its document identifier and its place are read, so that all
/// answers are about one file.
class IdentifiedItem : public platform::DocumentIdentifiers::OpenFile {
public:
    /// Opens the item at a path below the drive's home, else its promise, without following a link.
    static system::SystemResult<IdentifiedItem> open(const DriveLayout& layout, const std::string& path);

    /// Answers the identifier that the item carries; 0 for none. An error says nothing about that.
    system::SystemResult<std::uint32_t> identifier() const;
    /// Answers whether it carries this identifier, as far as can be read.
    bool carries(std::uint32_t identifier) const { return this->identifier().value == identifier; }
    /// Answers whether this is a file or a folder, or the promise of one. Nothing else can carry an
    /// identifier.
    bool canCarryIdentifier() const;
    /// Answers whether this is a file that is here.
    bool isFile() const { return !_isPromise && S_ISREG(_status.st_mode); }
    /// Writes another identifier to the item or its promise, wherever that was moved meanwhile. ESTALE means
    /// that the file was replaced or removed.
    system::SystemError carry(std::uint32_t identifier) const;

    std::uint64_t device() const { return _status.st_dev; }
    std::uint64_t inode() const { return _status.st_ino; }
    /// Answers the place where the item was opened.
    DocumentPlace place() const { return {_path, device(), inode()}; }
    /// Reads the open file; its place is the current one. Errors: ENOENT when the file was removed, EXDEV
    /// when it was moved out of the documents area, else the system's.
    platform::Result<Attributes> attributes() const override;

private:
    IdentifiedItem(DriveLayout layout, std::string path)
        : _layout(std::move(layout))
        , _path(std::move(path))
    {
    }

    DriveLayout _layout;
    std::string _path;
    host::system::FileDescriptor _file;
    struct stat _status { };
    bool _isPromise = false;
};

/// Answers the identifier of the item or promise at an absolute path; 0 for none. It is cheaper than holding
/// the item open, but only a hint, because links on the way are followed.
std::uint32_t identifierAt(const std::string& physicalPath);

} // namespace host::drive
