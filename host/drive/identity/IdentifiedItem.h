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

/// An item or its promise, held open while it is asked for its document identifier and its place, so that all
/// answers are about one file.
class IdentifiedItem : public platform::DocumentIdentifiers::OpenFile {
public:
    /// Opens what is at a path below the drive's home, without following a link: the item, else its promise.
    static system::SystemResult<IdentifiedItem> open(const DriveLayout& layout, const std::string& path);

    /// What it carries; 0 for none, and for a promise that cannot be read.
    std::uint32_t identifier() const;
    /// Whether it is a file or a folder, or the promise of one: nothing else can carry an identifier.
    bool canCarryIdentifier() const;
    /// Makes it carry another identifier. A promise is replaced by a new file, which this one is not.
    system::SystemError carry(std::uint32_t identifier) const;

    std::uint64_t device() const { return _status.st_dev; }
    std::uint64_t inode() const { return _status.st_ino; }
    /// Where the item was opened.
    DocumentPlace place() const { return {_path, device(), inode()}; }
    /// Asks the open file; its place is where it lies now. Errors: the system's, ENOENT when it has been
    /// removed, EXDEV when it was moved out of the documents area.
    platform::Result<Attributes> attributes() const override;

private:
    IdentifiedItem(const DriveLayout& layout, std::string path)
        : _layout(layout)
        , _path(std::move(path))
    {
    }
    system::SystemError carryInPromise(std::uint32_t identifier) const;

    DriveLayout _layout;
    std::string _path;
    host::system::FileDescriptor _file;
    struct stat _status { };
    bool _isPromise = false;
};

/// The identifier of what lies at an absolute path, an item or a promise; 0 for none. Cheaper than holding it
/// open, and only a hint: links on the way are followed.
std::uint32_t identifierAt(const std::string& physicalPath);

} // namespace host::drive
