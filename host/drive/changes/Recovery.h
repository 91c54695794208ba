// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/WorkRecord.h"

#include <string>

namespace host::drive {

class CloudStore;

/// Puts right what processes that were killed left behind: items under a private name come back, removals
/// and moves that were decided are finished, copies that are not whole go. Never removes what is not known to
/// lie elsewhere as well, or to have been asked to go. What cannot come back, because its name is taken or
/// its folder is gone, goes to the trash and is named in the log.
class Recovery {
public:
    Recovery(DriveLayout layout, CloudStore& store)
        : _layout(std::move(layout))
        , _store(store)
    {
    }
    /// Any thread, at any time: what living processes work on is left alone.
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
