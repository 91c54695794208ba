// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/AccountMonitor.h"

#include "host/drive/records/AccountRecord.h"
#include "platform/Log.h"
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
    monitor->begin();
    return monitor;
}

AccountMonitor::AccountMonitor(const DriveLayout& layout, const DriveDependencies& dependencies)
    : _layout(layout)
    , _dispatch(dependencies.dispatch)
    , _notifications(dependencies.notificationCenter)
    , _queue(_dispatch->makeSerialQueue("TarrowDriveAppID.account"))
{
}

void AccountMonitor::begin()
{
    static constexpr platform::Operation op{"-[AccountMonitor begin]"};
    // The folder is watched rather than the file, so that its creation and its replacement are seen.
    _folder = FollowedFolder::follow(_dispatch, _layout.home(), FollowedFolder::IfMissing::Wait,
        platform::weakly(this, [](AccountMonitor& self, const std::vector<std::string>& names) {
            if (mayHaveChanged(names, DriveLayout::accountFileName))
                self.check();
        }));
    if (!_folder->isWatched())
        op.warning("Cannot watch the account's folder %@", _layout.home());
    // Read after the watch began, so that no change falls between the two.
    _identity = currentIdentity(_layout);
}

void AccountMonitor::check()
{
    // What waits may have read the file already: it is read once more, so that the last change is seen.
    if (std::exchange(_checkIsWaiting, true)) {
        _checkAgain = true;
        return;
    }
    _queue->async([weak = weak_from_this(), layout = _layout, main = _dispatch->mainQueue()] {
        main->async(platform::weakly(weak, &AccountMonitor::identityRead, currentIdentity(layout)));
    });
}

void AccountMonitor::identityRead(std::optional<std::string> identity)
{
    _checkIsWaiting = false;
    if (std::exchange(_checkAgain, false))
        check();
    const bool changed = identity != _identity;
    _identity = std::move(identity);
    if (_fileChanged)
        _fileChanged();
    if (changed)
        _notifications->post(platform::Notification::CloudIdentityDidChange);
}

} // namespace host::drive
