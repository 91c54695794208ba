// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/DriveUpkeep.h"

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/Recovery.h"
#include "host/system/files/SystemErrors.h"
#include "platform/Log.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

namespace {

/// A person deletes and downloads several items in a row, and one walk serves them all.
constexpr auto settled = std::chrono::seconds(5);
constexpr auto laterOn = std::chrono::minutes(1);
/// Work that takes less is over before anyone has read about it.
constexpr auto worthSaying = std::chrono::milliseconds(500);

} // namespace

DriveUpkeep::DriveUpkeep(DriveLayout layout, std::shared_ptr<CloudStore> store,
    const std::shared_ptr<platform::Dispatch>& dispatch)
    : _layout(std::move(layout))
    , _store(std::move(store))
    , _dispatch(dispatch)
    , _queue(dispatch->makeSerialQueue("TarrowDriveAppID.upkeep"))
{
}

void DriveUpkeep::putRight()
{
    Recovery(_layout, *_store).run();
    static_cast<void>(ContentCollection(_layout).run());
}

void DriveUpkeep::putRightBeside()
{
    _queue->async(platform::weakly(shared_from_this(), &DriveUpkeep::putAllRight));
}

void DriveUpkeep::putAllRight()
{
    static constexpr platform::Operation op{"-[DriveUpkeep putAllRight]"};
    Recovery recovery(_layout, *_store);
    settleRecords(recovery);
    if (const auto failure = recovery.settleStraysAmongItems())
        op.warning("Cannot search the drive for private names: %@", failure);
    collect();
}

void DriveUpkeep::settleRecords(Recovery& recovery)
{
    const auto tell = platform::weakly(shared_from_this(), &DriveUpkeep::tell);
    _isSettling = true;
    _dispatch->after(worthSaying, _dispatch->mainQueue(), tell);
    recovery.run();
    _isSettling = false;
    _dispatch->mainQueue()->async(tell);
}

void DriveUpkeep::tell()
{
    const bool isSettling = _isSettling;
    if (std::exchange(_isTold, isSettling) != isSettling && _changed)
        _changed();
}

void DriveUpkeep::contentReleased()
{
    collectAfter(settled);
}

void DriveUpkeep::collectAfter(platform::Duration delay)
{
    if (!_isCollectionDue.exchange(true))
        _dispatch->after(delay, _queue, platform::weakly(shared_from_this(), &DriveUpkeep::collect));
}

void DriveUpkeep::collect()
{
    static constexpr platform::Operation op{"-[DriveUpkeep collect]"};
    _isCollectionDue = false;
    const auto outcome = ContentCollection(_layout).run();
    if (!outcome)
        op.warning("Cannot look for contents to remove: %@", outcome.error);
    else if (*outcome == ContentCollection::Outcome::Later)
        collectAfter(laterOn);
}

} // namespace host::drive
