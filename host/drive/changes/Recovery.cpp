// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/Recovery.h"

#include "host/drive/changes/Discarding.h"
#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/PromiseFile.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"
#include "platform/Log.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::lastName;
using host::system::SystemError;

namespace {

bool isThere(const DriveEntry& entry)
{
    return static_cast<bool>(entry.status());
}

/// Answers the same private name with another prefix.
DriveEntry renamed(const DriveEntry& entry, const char* prefix)
{
    return {FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0)),
        prefix + entry.name.substr(entry.name.find('-') + 1), entry.path};
}

/// Answers the path of the document that a promise's name stands for. Any other name stands for itself.
std::string documentPath(const std::string& path)
{
    return PromiseRecord::itemPathFor(path).value_or(path);
}

/// Answers the promise of this very name in an open folder.
std::optional<PromiseRecord> promiseAt(const DriveEntry& entry)
{
    const auto text = system::readWholeFile(entry.folder, entry.name, PromiseRecord::maximumFileSize);
    return text ? PromiseRecord::parse(*text) : std::nullopt;
}

/// Answers whether a held promise and the one in its place say the same but for the tags, which were being
/// changed.
bool differsInTagsAlone(const DriveEntry& held, const DriveEntry& origin)
{
    auto before = PromiseRecord::itemPathFor(origin.path) ? promiseAt(held) : std::nullopt;
    const auto now = before ? promiseAt(origin) : std::nullopt;
    if (!now)
        return false;
    before->tags = now->tags;
    return before == now;
}

} // namespace

void Recovery::run()
{
    WorkRecord::forEachAbandoned(
        _layout, [this](const WorkRecord::Places& places) { return settle(places); });
    settleStrays();
}

platform::Result<DriveEntry> Recovery::entryAt(const std::string& path) const
{
    const std::string name(lastName(path));
    const auto& trash = _layout.trash();
    const bool isHeld = path == _layout.held() + '/' + name;
    if (!isHeld && !path.starts_with(trash + '/'))
        return DriveEntry::open(_layout, path);
    // What is in the trash lies in a folder of its own there.
    auto folder = isHeld
        ? openOwnFolder(_layout.held())
        : openBeneath(trash, "." + host::system::parentPath(path).substr(trash.size()), O_PATH | O_DIRECTORY);
    return folder ? platform::Result<DriveEntry>(DriveEntry{std::move(*folder), name, path})
                  : itemError(folder.error, path);
}

bool Recovery::settle(const WorkRecord::Places& places)
{
    return lastName(places.working).starts_with(WorkRecord::temporaryPrefix) ? settleCopy(places)
                                                                             : settleHeld(places);
}

bool Recovery::settleCopy(const WorkRecord::Places& places)
{
    static constexpr platform::Operation op{"-[Recovery settleCopy:]"};
    const auto temporary = entryAt(places.working);
    auto failure =
        temporary ? removeTree(temporary->folder, temporary->name) : SystemError(ENOENT, places.working);
    if ((!failure || failure.is(ENOENT)) && !places.copy.empty())
        failure = finishMove(places);
    const auto document = entryAt(documentPath(places.item));
    if (document)
        dropRedundantPromise(*document, _store);
    if (!failure || failure.is(ENOENT))
        return true;
    op.warning("Cannot settle what was left of %@: %@", places.item, itemError(failure, places.item));
    return false;
}

SystemError Recovery::finishMove(const WorkRecord::Places& places)
{
    const auto item = entryAt(places.item), copy = entryAt(places.copy);
    if (!item || !copy || !isSameTree(item->folder, item->name, copy->folder, copy->name))
        return {};
    auto held = HeldItem::take(_layout, *item, item->name, places.copy);
    if (!held)
        return held.error;
    // When something changed between the two comparisons, the item is put back.
    if (!isSameTree(held->folder(), held->name(), copy->folder, copy->name))
        return {};
    return held->remove(nullptr);
}

bool Recovery::settleHeld(const WorkRecord::Places& places)
{
    const auto held = entryAt(places.working);
    if (!held)
        return true; // the item's folder is gone, and the item with it
    const auto gone = renamed(*held, WorkRecord::gonePrefix), moved = renamed(*held, WorkRecord::movedPrefix);
    if (isThere(gone))
        return discard(gone, true);
    if (isThere(moved))
        return discard(moved, false);
    if (!isThere(*held))
        return true;
    const auto copy = entryAt(places.copy);
    if (copy && isSameTree(held->folder, held->name, copy->folder, copy->name))
        return discard(*held, false);
    return putBack(*held, places.item);
}

bool Recovery::discard(const DriveEntry& entry, bool contentsToo)
{
    static constexpr platform::Operation op{"-[Recovery discard:]"};
    const auto failure = discardTree(entry.folder, entry.name, contentsToo ? &_store : nullptr).failure;
    if (failure)
        op.warning("Cannot remove the rest of %@: %@", entry.path, failure);
    return !failure;
}

bool Recovery::putBack(const DriveEntry& held, const std::string& item)
{
    const auto origin = entryAt(item);
    if (origin && differsInTagsAlone(held, *origin))
        return discard(held, false);
    const auto failure = origin ? renameEntry(held.folder, held.name, origin->folder, origin->name)
                                : SystemError(ENOENT, item);
    if (!failure)
        return !syncFolder(origin->folder);
    return (failure.is(EEXIST) || failure.is(ENOENT)) && moveToTrash(held, item);
}

bool Recovery::moveToTrash(const DriveEntry& held, const std::string& item)
{
    static constexpr platform::Operation op{"-[Recovery moveToTrash:]"};
    constexpr int mostOfOneName = 1000;
    const auto trash = openOwnFolder(_layout.trash());
    const auto path = descriptorPath(held.folder) + '/' + held.name;
    ::lsetxattr(path.c_str(), itemMark::origin, item.data(), item.size(), 0);
    const auto document = PromiseRecord::itemPathFor(lastName(item));
    auto failure = trash ? SystemError(EEXIST) : trash.error;
    for (int number = 1; failure.is(EEXIST) && number < mostOfOneName; ++number) {
        auto name = document.value_or(std::string(lastName(item)));
        if (number > 1)
            name += ' ' + std::to_string(number);
        failure = renameEntry(held.folder, held.name, *trash, document ? PromiseRecord::pathFor(name) : name);
    }
    if (!failure)
        op.warning("Cannot put back %@: it is in the trash now", item);
    else
        op.error("Cannot put back %@, kept as %@: %@", item, held.path, itemError(failure, item));
    return !failure;
}

void Recovery::settleStrays()
{
    const auto folder = system::openFolder(_layout.held());
    if (!folder)
        return;
    const auto names = readNames(*folder);
    if (!names)
        return;
    for (const auto& name : *names) {
        // On a full disk an item may be held without a record.
        const auto held = entryAt(_layout.held() + '/' + name);
        if (!held || WorkRecord::isRecorded(_layout, name) || !isProcessGone(name))
            continue;
        if (name.starts_with(WorkRecord::heldPrefix))
            moveToTrash(*held, "Recovered " + name.substr(name.find('-') + 1));
        else if (name.starts_with(WorkRecord::gonePrefix))
            discard(*held, true);
        else if (name.starts_with(WorkRecord::movedPrefix))
            discard(*held, false);
    }
}

} // namespace host::drive
