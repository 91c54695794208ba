// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/HeldItem.h"

#include "host/drive/changes/Discarding.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"
#include "platform/Log.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

bool isOnOneFileSystem(const FileDescriptor& a, const FileDescriptor& b)
{
    struct stat first, second;
    return ::fstat(a.get(), &first) == 0 && ::fstat(b.get(), &second) == 0 && first.st_dev == second.st_dev;
}

/// A promise stays recognisable by its name while it is held.
std::string heldName(const std::string& name)
{
    auto held = uniqueName(WorkRecord::heldPrefix);
    if (PromiseRecord::isPromiseName(name))
        held += PromiseRecord::suffix;
    return held;
}

} // namespace

HeldItem::HeldItem(HeldItem&& other) noexcept
    : _origin(std::move(other._origin))
    , _aside(std::move(other._aside))
    , _record(std::move(other._record))
    , _originName(std::move(other._originName))
    , _name(std::move(other._name))
    , _path(std::move(other._path))
    , _isAside(other._isAside)
    , _isThere(std::exchange(other._isThere, false))
{
}

HeldItem::~HeldItem()
{
    if (_isThere)
        putBack();
}

SystemResult<HeldItem> HeldItem::take(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& name, const std::string& copy)
{
    HeldItem item;
    auto aside = openOwnFolder(layout.held());
    item._origin = FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0));
    if (!aside)
        return aside.error;
    if (!item._origin)
        return SystemError::last(entry.path);
    item._aside = std::move(*aside);
    item._isAside = isOnOneFileSystem(item._aside, item._origin);
    item._originName = name;
    item._path = entry.path;
    item._name = heldName(name);
    const auto origin = system::siblingPath(entry.path, name);
    const auto working =
        item._isAside ? layout.held() + '/' + item._name : system::siblingPath(entry.path, item._name);
    auto record = WorkRecord::write(layout, {origin, working, copy});
    if (!record)
        return record.error;
    item._record.emplace(std::move(*record));
    TRW_TRY(renameEntry(item._origin, name, item.folder(), item._name));
    item._isThere = true;
    return item;
}

SystemError HeldItem::decide(const char* prefix)
{
    auto decided = prefix + _name.substr(std::string_view(WorkRecord::heldPrefix).size());
    TRW_TRY(renameEntry(folder(), _name, folder(), decided));
    _name = std::move(decided);
    return syncFolder(_origin);
}

SystemError HeldItem::remove(CloudStore* store)
{
    static constexpr platform::Operation op{"-[HeldItem remove]"};
    Discarded discarded{Discarded::Part::Nothing, checkRemovable(folder(), _name)};
    if (!discarded.failure)
        discarded.failure = decide(store ? WorkRecord::gonePrefix : WorkRecord::movedPrefix);
    if (!discarded.failure)
        discarded = discardTree(folder(), _name, store);
    if (discarded.part == Discarded::Part::Nothing) {
        putBack();
        return discarded.failure;
    }
    _isThere = false;
    if (discarded.part == Discarded::Part::Something) {
        op.warning("Not all of %@ could be removed yet: %@", _path, discarded.failure);
        _record->keep();
    }
    return {};
}

SystemError HeldItem::removePromise(CloudStore& store)
{
    auto discarded = discardTree(folder(), _name, &store);
    if (discarded.failure)
        putBack();
    _isThere = false;
    return discarded.failure;
}

void HeldItem::putBack()
{
    static constexpr platform::Operation op{"-[HeldItem putBack]"};
    _isThere = false;
    const auto failure = renameEntry(folder(), _name, _origin, _originName);
    if (!failure)
        return;
    // Another program saved a new item meanwhile, or the folder is gone, so both items are kept. The held one
    // gets a name without the decision to remove it, because the next start would otherwise remove it.
    if (!_name.starts_with(WorkRecord::heldPrefix)) {
        auto undecided = WorkRecord::heldPrefix + _name.substr(_name.find('-') + 1);
        if (!renameEntry(folder(), _name, folder(), undecided))
            _name = std::move(undecided);
    }
    op.warning("Cannot put back %@, kept as %@: %@", _path, _name, itemError(failure, _path));
    _record->keep();
}

} // namespace host::drive
