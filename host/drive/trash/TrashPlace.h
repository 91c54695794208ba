// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/trash/TrashRecord.h"

#include <optional>
#include <string>

namespace host::drive {

/// The folder of one item in the trash. It holds the item under its own name and the record beside it, which
/// is on the disk before the item comes. Any thread.
class TrashPlace {
public:
    /// The names of these folders begin so. What else lies in the trash was put there by a start that could
    /// not put it back (Recovery).
    static constexpr const char* prefix = ".trwtrash-";
    static bool isPlace(std::string_view name) { return name.starts_with(prefix); }

    /// Makes a place with its record.
    static system::SystemResult<TrashPlace> make(
        const system::FileDescriptor& trash, const std::string& trashPath, const TrashRecord& record);
    /// Opens a place. `name` is its own in the trash.
    static system::SystemResult<TrashPlace> open(
        const system::FileDescriptor& trash, const std::string& trashPath, const std::string& name);

    const std::string& name() const { return _name; }
    /// Answers what the record says, or nothing when it is missing or damaged. An error means that it could
    /// not be read.
    system::SystemResult<std::optional<TrashRecord>> record() const;
    /// Replaces the record.
    system::SystemError write(const TrashRecord& record) const;

    /// Answers the place for an item of this name (its promise's name, when it is one).
    DriveEntry entry(const std::string& itemName) const;
    /// Answers the item in here; ENOENT when there is none.
    system::SystemResult<LocatedItem> item() const;

    /// Removes the folder, with its record and with copies that are not whole, when it has no item. Nobody
    /// may be about to bring one.
    void dropIfEmpty(const system::FileDescriptor& trash) const;

private:
    TrashPlace() = default;

    system::FileDescriptor _folder;
    std::string _name, _path;
};

/// Answers an item in an open folder by its name on disk, which may be a promise's.
system::SystemResult<LocatedItem> locateIn(
    const system::FileDescriptor& folder, const std::string& folderPath, const std::string& nameOnDisk);

} // namespace host::drive
