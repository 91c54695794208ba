// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileChanges.h"

#include <functional>
#include <string>

namespace host::drive {

/// A process writes a record before it gives an item, or a copy of one, a private name, so that the next
/// start can repair the drive if the process is killed. The destructor removes the record. Until then it is
/// locked, so that others can tell that its process lives.
///
/// The text of a record is an extended attribute (recordAttribute), because journals of file systems keep the
/// order of names and attributes: after a power cut there is no private name without the text of its record.
/// What a file holds would have to be synced for that. It holds the text where attributes are impossible.
class WorkRecord {
public:
    /// Absolute paths of names on disk. For a promise they are those of its file.
    struct Places {
        std::string item; ///< the item's own place
        std::string working; ///< the private name of the item itself (heldPrefix) or of a copy
        std::string copy = {}; ///< the place of a whole copy of the item; empty: none
        std::string content = {}; ///< the content that an evicted document gets; empty: none
        /// The versions (versionText()) that a save replaces and puts in its place; empty: none.
        std::string replaced = {}, replacing = {};
    };
    static constexpr const char* recordAttribute = "user.trw.work";
    /// Answers the text of a version of the item. It does not name the device, because the disk may have
    /// another number after a restart, and both versions lie in the item's folder.
    static std::string versionText(const platform::ItemVersion& version);

    /// The prefix of an item that was taken out of its folder and will be put back.
    static constexpr const char* heldPrefix = ".trwheld-";
    /// The prefix of an item whose removal, with the contents behind its promises, is decided and only takes
    /// time.
    static constexpr const char* gonePrefix = ".trwgone-";
    /// The prefix of the original of an item that was copied elsewhere. The contents behind its promises are
    /// kept.
    static constexpr const char* movedPrefix = ".trwmoved-";
    /// The prefix of a copy that is not whole yet.
    static constexpr const char* temporaryPrefix = ".trwtmp-";

    /// Writes a record. A full disk is no error, because items must be removable then; the record is empty in
    /// that case. Errors are of the drive and not of the item (SystemError::ofDrive()).
    static system::SystemResult<WorkRecord> write(const DriveLayout& layout, const Places& places);
    /// Calls `settle` for every record whose process has ended. When it answers true the record is removed;
    /// otherwise the record stays for another time.
    static void forEachAbandoned(const DriveLayout& layout, const std::function<bool(const Places&)>& settle);
    /// Answers whether a name in the private folder is a record's name or has a record.
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
