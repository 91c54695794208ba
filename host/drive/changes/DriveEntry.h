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

/// A name in an open folder of the drive. Operations on it stay in that very folder, whatever other programs
/// do to the path meanwhile.
struct DriveEntry {
    host::system::FileDescriptor folder; ///< opened with O_PATH
    std::string name;
    std::string path; ///< used in errors only

    /// Opens the folder of a path below the documents area without following any link. Errors: EXDEV for a
    /// path outside the area and for the area itself, else the reason why the folder cannot be opened.
    static platform::Result<DriveEntry> open(const DriveLayout& layout, const std::string& path);

    /// Answers the status of the name, without following a link.
    host::system::SystemResult<struct stat> status() const;
    /// Answers the name of this entry's promise.
    std::string promiseName() const;
    /// A name on disk and its status.
    struct Found {
        std::string name;
        struct stat status;
    };
    /// Finds the name on disk that stands for the item, which is the item's own or its promise's. Answers
    /// ENOENT when there is neither.
    host::system::SystemResult<Found> find() const;
    /// Answers EEXIST when an item or a promise has the name already.
    host::system::SystemError checkIsFree() const;
};

/// An item that was found: the name on disk that stands for it, and the status of that name.
struct LocatedItem {
    DriveEntry entry;
    std::string name;
    struct stat found { };

    /// Finds an item. Errors: those of DriveEntry::open(), and FileErrorCode::NoSuchItem when there is
    /// neither an item nor a promise.
    static platform::Result<LocatedItem> locate(const DriveLayout& layout, const std::string& path);
    bool isPromise() const { return name != entry.name; }
};

using host::system::syncFolder;
using host::system::uniqueName;
using host::system::versionOf;
/// Answers whether both are versions of one item with one content. A rename in between changes only the
/// status change time, which is not compared.
bool isSameContent(const platform::ItemVersion& a, const platform::ItemVersion& b);

/// Answers whether both are the status of one file.
inline bool isSameFile(const struct stat& a, const struct stat& b)
{
    return a.st_dev == b.st_dev && a.st_ino == b.st_ino;
}
/// Answers the status of a name in an open folder, without following a link.
host::system::SystemResult<struct stat> statusAt(
    const host::system::FileDescriptor& folder, const std::string& name);
/// Renames an item and never replaces one (EEXIST). Where the file system cannot rename in this way, a name
/// is claimed first: a file's by a link, a folder's by an empty folder. EOPNOTSUPP means that it cannot do
/// that either.
host::system::SystemError renameEntry(const host::system::FileDescriptor& from, const std::string& name,
    const host::system::FileDescriptor& to, const std::string& newName);
/// Opens one of the drive's private folders, and makes it when it is missing. Only the user may enter it. Its
/// errors are of the drive and not of an item (SystemError::ofDrive()).
host::system::SystemResult<host::system::FileDescriptor> openOwnFolder(const std::string& path);
/// Answers whether a name has a meaning of its own in the drive, so that an item with it would not be seen:
/// the private names of work that is under way, and those of promises.
bool isReservedName(std::string_view name);
/// Answers the error for a location with such a name: FileErrorCode::InvalidName.
platform::Error reservedName(const std::string& path);

} // namespace host::drive
