#include "host/drive/AccountMonitor.h"

#include "host/drive/AccountRecord.h"
#include "platform/Log.h"

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
    monitor->watch();
    return monitor;
}

AccountMonitor::AccountMonitor(const DriveLayout& layout, const DriveDependencies& dependencies)
    : _layout(layout)
    , _dispatch(dependencies.dispatch)
    , _notifications(dependencies.notificationCenter)
    , _queue(_dispatch->makeSerialQueue("TarrowDriveAppID.account"))
{
}

void AccountMonitor::watch()
{
    static constexpr platform::Operation op{"-[AccountMonitor watch]"};
    // The folder is watched rather than the file, so that its creation and its replacement are seen.
    _watch = FolderWatch::start(_layout.home(), [weak = weak_from_this()](const std::string& name) {
        if (const auto self = weak.lock())
            self->nameChanged(name);
    });
    if (!_watch)
        op.warning("Cannot watch the account's folder %@", _layout.home());
    // Read after the watch began, so that no change falls between the two.
    _identity = currentIdentity(_layout);
}

void AccountMonitor::nameChanged(const std::string& name)
{
    if (!name.empty() && name != DriveLayout::accountFileName)
        return;
    check();
}

void AccountMonitor::check()
{
    if (_checkIsWaiting)
        return;
    _checkIsWaiting = true;
    _queue->async([weak = weak_from_this(), layout = _layout, main = _dispatch->mainQueue()] {
        main->async([weak, identity = currentIdentity(layout)] {
            if (const auto self = weak.lock())
                self->identityRead(identity);
        });
    });
}

void AccountMonitor::identityRead(std::optional<std::string> identity)
{
    _checkIsWaiting = false;
    const bool changed = identity != _identity;
    _identity = std::move(identity);
    if (_fileChanged)
        _fileChanged();
    if (changed)
        _notifications->post(platform::Notification::CloudIdentityDidChange);
}

} // namespace host::drive
