// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/ActivityPublication.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/ActivityRecord.h"
#include "host/drive/records/DeviceIdentity.h"
#include "host/system/files/AtomicWrite.h"
#include "platform/Log.h"
#include "platform/Weakly.h"

#include <sys/stat.h>
#include <unistd.h>

#include <utility>

namespace host::drive {

namespace {

constexpr platform::Duration renewalLeeway = std::chrono::seconds(30);

} // namespace

ActivityPublication::ActivityPublication(DriveLayout layout, std::shared_ptr<platform::Dispatch> dispatch)
    : _layout(std::move(layout))
    , _dispatch(std::move(dispatch))
    , _queue(_dispatch->makeSerialQueue("TarrowDriveAppID.activity"))
{
}

ActivityPublication::~ActivityPublication()
{
    removeFile();
}

void ActivityPublication::becomeCurrent(const Activity& activity)
{
    const std::lock_guard lock(_mutex);
    set(activity);
}

void ActivityPublication::resignCurrent(const Activity& activity)
{
    const std::lock_guard lock(_mutex);
    if (activity && activity == _current)
        set(nullptr);
}

void ActivityPublication::set(const Activity& activity)
{
    _current = activity;
    const auto update = platform::weakly(this, &ActivityPublication::bringUpToDate);
    // The timer also calls at once.
    if (activity && activity->isEligibleForHandOff) {
        _renewal = _dispatch->startTimer(_queue, renewal, renewalLeeway, update);
    } else {
        _renewal = nullptr;
        _queue->async(update);
    }
}

/// Writes the activity that is current now, whatever was current when this was posted, so that a preview that
/// is left at once leaves no trace.
void ActivityPublication::bringUpToDate()
{
    Activity current;
    {
        const std::lock_guard lock(_mutex);
        current = _current;
    }
    if (current && current->isEligibleForHandOff)
        write(*current);
    else
        removeFile();
}

void ActivityPublication::write(const platform::UserActivity& activity)
{
    static constexpr platform::Operation op{"-[ActivityPublication write:]"};
    const auto account = AccountRecord::read(_layout);
    if (!account)
        return removeFile();
    const auto device = DeviceIdentity::atFile(_layout.device());
    const ActivityRecord record{
        device.identifier, device.name, account->identity, activity, _dispatch->now()};
    const auto path = _layout.activities() + '/' + ActivityRecord::fileName(device.identifier);
    ::mkdir(_layout.activities().c_str(), 0700); // the write reports a failure
    const std::lock_guard lock(_fileMutex);
    _written = path;
    if (const auto error = host::system::writeFileAtomically(path, record.toJson()))
        op.warning("Cannot tell the other devices of the activity: %@", *error);
}

void ActivityPublication::removeFile()
{
    const std::lock_guard lock(_fileMutex);
    if (!_written.empty())
        ::unlink(std::exchange(_written, {}).c_str());
}

} // namespace host::drive
