// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/FileVersion.h"
#include "host/system/files/SystemError.h"
#include "platform/FileChanges.h"

#include <sys/stat.h>

#include <string>

namespace host::drive {

/// A name in an open folder of the drive. What is done by it stays in that very folder, whatever others do to
/// the path meanwhile.
struct DriveEntry {
    host::system::FileDescriptor folder; ///< opened with O_PATH
    std::string name;
    std::string path; ///< for errors only

    /// Opens the folder of a path below the documents area without following any link. Errors: EXDEV for a
    /// path that lies elsewhere or is the area itself, else why the folder cannot be had.
    static platform::Result<DriveEntry> open(const DriveLayout& layout, const std::string& path);

    /// What the name is now, a link not followed.
    host::system::SystemResult<struct stat> status() const;
    /// The same entry's promise.
    std::string promiseName() const;
    /// A name on disk and what it is.
    struct Found {
        std::string name;
        struct stat status;
    };
    /// The name on disk that stands for the item, the item's own or its promise's, and what it is now. ENOENT
    /// when there is neither.
    host::system::SystemResult<Found> find() const;
    /// EEXIST when an item or a promise has the name already.
    host::system::SystemError checkIsFree() const;
};

/// An item that was found: the name on disk that stands for it, and what that was.
struct LocatedItem {
    DriveEntry entry;
    std::string name;
    struct stat found { };

    /// Errors: as DriveEntry::open(), and FileErrorCode::NoSuchItem where neither item nor promise lies.
    static platform::Result<LocatedItem> locate(const DriveLayout& layout, const std::string& path);
    bool isPromise() const { return name != entry.name; }
};

using host::system::syncFolder;
using host::system::uniqueName;
using host::system::versionOf;
/// Whether both are one item of one content; a rename in between changes no more than the time of change.
bool isSameContent(const platform::ItemVersion& a, const platform::ItemVersion& b);

/// What a name in an open folder is, a link not followed.
host::system::SystemResult<struct stat> statusAt(
    const host::system::FileDescriptor& folder, const std::string& name);
/// Renames without replacing anything (EEXIST).
host::system::SystemError renameEntry(const host::system::FileDescriptor& from, const std::string& name,
    const host::system::FileDescriptor& to, const std::string& newName);
/// Opens a folder of the drive's own, which is made when it is missing and which the user alone may enter.
host::system::SystemResult<host::system::FileDescriptor> openOwnFolder(const std::string& path);
/// Whether the process that made such a name (see uniqueName()) is known to be gone.
bool isProcessGone(const std::string& uniqueName);

} // namespace host::drive
