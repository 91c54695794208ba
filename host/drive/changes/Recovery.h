// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <string>

namespace host::drive {

class CloudStore;

/// Repairs the drive after processes that were killed. Items under a private name are put back, decided
/// removals and moves are finished, and incomplete copies are removed. It removes only items that are known
/// to exist elsewhere or whose removal was requested. An item that cannot be put back, because its name is
/// taken or its folder is gone, is moved to the trash and named in the log.
class Recovery {
public:
    Recovery(DriveLayout layout, CloudStore& store)
        : _layout(std::move(layout))
        , _store(store)
    {
    }
    /// Any thread, at any time, because it leaves the work of living processes alone.
    void run();

private:
    bool settle(const WorkRecord::Places& places);
    bool settleCopy(const WorkRecord::Places& places);
    bool settleHeld(const WorkRecord::Places& places);
    bool discard(const DriveEntry& entry, bool contentsToo);
    system::SystemError finishMove(const WorkRecord::Places& places);
    bool putBack(const DriveEntry& held, const std::string& item);
    bool moveToTrash(const DriveEntry& held, const std::string& item);
    void settleStrays();
    platform::Result<DriveEntry> entryAt(const std::string& path) const;

    DriveLayout _layout;
    CloudStore& _store;
};

} // namespace host::drive
