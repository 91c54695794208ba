// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/system/files/SystemError.h"

#include <cstdint>
#include <set>
#include <string>

namespace host::drive {

/// Removes the contents that were released (CloudStore::release()), once it is certain that no promise names
/// them. Another program may have copied a promise, or put one back from a backup; such a promise keeps its
/// content, which then belongs to it again. A package that is in the cloud may hold promises itself, and
/// these count while it is there.
///
/// Certain is what two walks through all promises say in the same way: a promise that was moved in between
/// has changed its folder. Where anything cannot be read, nothing is removed.
class ContentCollection {
public:
    enum class Outcome : std::uint8_t {
        Done,
        Later, ///< something changed meanwhile, another process is at it, or the last walk is too recent
    };
    explicit ContentCollection(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }
    /// Does nothing when nothing was released. Any thread; it reads every promise of the drive twice, for at
    /// most a twentieth of the time.
    system::SystemResult<Outcome> run();

    /// Answers the contents that no promise names and that were not released, because no program of ours has
    /// removed their promises. It reads every promise once, and again when it finds one. A promise that is
    /// moved about meanwhile may escape it, so what is done with a content must leave it to such a promise.
    /// Any thread.
    system::SystemResult<std::set<std::string>> orphans();

private:
    system::SystemResult<Outcome> collect(const std::set<std::string>& released);

    DriveLayout _layout;
};

} // namespace host::drive
