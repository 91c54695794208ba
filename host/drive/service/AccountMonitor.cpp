// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/AccountMonitor.h"

#include "host/drive/records/AccountRecord.h"
#include "platform/Weakly.h"

#include <utility>

namespace host::drive {

namespace {

std::optional<std::string> currentIdentity(const DriveLayout& layout)
{
    const auto record = AccountRecord::read(layout);
    return record ? std::optional(record->identity) : std::nullopt;
}

} // namespace

std::shared_ptr<AccountMonitor> AccountMonitor::start(
    const DriveLayout& layout, const DriveDependencies& dependencies)
{
    std::shared_ptr<AccountMonitor> monitor(new AccountMonitor(layout, dependencies));
    monitor->begin(dependencies);
    return monitor;
}

AccountMonitor::AccountMonitor(DriveLayout layout, const DriveDependencies& dependencies)
    : _layout(std::move(layout))
    , _notifications(dependencies.notificationCenter)
{
}

void AccountMonitor::begin(const DriveDependencies& dependencies)
{
    const auto read = [weak = weak_from_this(), layout = _layout]() -> FollowedFile::Deliver {
        return platform::weakly(weak, &AccountMonitor::identityRead, currentIdentity(layout));
    };
    _file = FollowedFile::follow(dependencies.dispatch, _layout.account(), "TarrowDriveAppID.account", read);
    // The file is read after the watch has begun, so that no change is missed in between.
    _identity = currentIdentity(_layout);
}

void AccountMonitor::identityRead(std::optional<std::string> identity)
{
    const bool changed = identity != _identity;
    _identity = std::move(identity);
    if (_fileChanged)
        _fileChanged();
    if (changed)
        _notifications->post(platform::Notification::CloudIdentityDidChange);
}

} // namespace host::drive
