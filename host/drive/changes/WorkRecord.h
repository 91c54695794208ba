// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"

#include <functional>
#include <string>

namespace host::drive {

/// What a process writes down before it gives an item, or a copy of one, a private name, so that the next
/// start can put things right if it is killed. The record goes when this is destroyed; while this lives it is
/// locked, so that others can tell that its process lives.
class WorkRecord {
public:
    /// Absolute paths of names on disk, for a promise its file's.
    struct Places {
        std::string item; ///< where the item belongs
        std::string working; ///< the private name: of the item itself (heldPrefix) or of a copy
        std::string copy; ///< where a whole copy of the item is put; empty: nowhere
    };

    /// An item that was taken out of its folder and will be put back.
    static constexpr const char* heldPrefix = ".trwheld-";
    /// An item whose removal is decided, with the contents behind promises; it only takes time.
    static constexpr const char* gonePrefix = ".trwgone-";
    /// The same for the original of an item that was copied elsewhere, whose promises keep their contents.
    static constexpr const char* movedPrefix = ".trwmoved-";
    /// A copy that is not whole yet.
    static constexpr const char* temporaryPrefix = ".trwtmp-";

    /// Writes a record. A full disk is no error, since something must be removable there: the record is then
    /// empty.
    static system::SystemResult<WorkRecord> write(const DriveLayout& layout, const Places& places);
    /// Hands out every record whose process is gone. Those that `settle` answers true for go; the others stay
    /// for another time.
    static void forEachAbandoned(const DriveLayout& layout, const std::function<bool(const Places&)>& settle);
    /// Whether a name of the private folder is a record's, or has one.
    static bool isRecorded(const DriveLayout& layout, const std::string& name);

    WorkRecord(WorkRecord&& other) noexcept;
    WorkRecord& operator=(WorkRecord&&) = delete;
    ~WorkRecord();

    /// Leaves the record for the next start.
    void keep() { _path.clear(); }

private:
    WorkRecord() = default;

    system::FileDescriptor _file;
    std::string _path;
};

} // namespace host::drive
