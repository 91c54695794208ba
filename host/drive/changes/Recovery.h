// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <chrono>
#include <string>

namespace host::drive {

class CloudStore;

/// Repairs the drive after processes that were killed. Items under a private name are put back, decided
/// removals and moves are finished, and incomplete copies are removed. It removes only items that are known
/// to exist elsewhere or whose removal was requested. An item that cannot be put back, because its name is
/// taken or its folder is gone, is moved to the trash and named in the log.
class Recovery {
public:
    /// What has a private name, but no record, is left alone for as long as `strayPatience` after its last
    /// change.
    Recovery(DriveLayout layout, CloudStore& store,
        std::chrono::nanoseconds strayPatience = std::chrono::minutes(10))
        : _layout(std::move(layout))
        , _store(store)
        , _strayPatience(strayPatience)
    {
    }
    /// Any thread, at any time, because it leaves the work of living processes alone.
    void run();
    /// Finds what has a private name among the items without any record of it, which a power cut can leave,
    /// and settles that, too. It looks at every name of the drive. Any thread, at any time.
    system::SystemError settleStraysAmongItems();

private:
    bool settle(const WorkRecord::Places& places);
    bool settleCopy(const WorkRecord::Places& places);
    bool settleHeld(const WorkRecord::Places& places);
    bool settleSave(const DriveEntry& held, const struct stat& found, const WorkRecord::Places& places);
    system::SystemError removeCopy(const std::string& path) const;
    system::SystemError settlePromise(const WorkRecord::Places& places);
    system::SystemError settleOwnTwin(const std::string& item);
    bool discard(const DriveEntry& entry, bool contentsToo);
    system::SystemError finishMove(const WorkRecord::Places& places);
    bool putBack(const DriveEntry& held, const std::string& item);
    bool moveToTrash(const DriveEntry& held, const std::string& item);
    void settleStrays();
    void settleStray(const DriveEntry& stray, const std::string& item);
    bool isAtWork(const DriveEntry& stray) const;
    platform::Result<DriveEntry> entryAt(const std::string& path) const;

    DriveLayout _layout;
    CloudStore& _store;
    std::chrono::nanoseconds _strayPatience;
};

} // namespace host::drive
