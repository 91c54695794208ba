// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalItemChanges.h"

#include "host/drive/changes/CloudStore.h"
#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/FileVersion.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::systemError;
using host::system::SystemResult;
using platform::Error;
using platform::FileErrorCode;
using platform::ItemVersion;

namespace {

/// These two numbers stand for refusals between the steps below. No system call of those steps fails with
/// them otherwise.
constexpr int changedMeanwhile = ECANCELED;
constexpr int ownFolder = EDEADLK;

/// Answers whether an open folder is one of a tree's. The comparison is by inode, because a mount can give
/// the folder another path.
bool holdsFolder(const TreeVersions& tree, const FileDescriptor& folder)
{
    struct stat found;
    return ::fstat(folder.get(), &found) == 0 && tree.contains({found.st_dev, found.st_ino});
}

/// Answers whether a tree is the one that was located.
bool isStill(const LocatedItem& item, const TreeVersions& tree)
{
    const auto version = versionOf(item.found);
    const auto same = tree.find({version.device, version.inode});
    return same != tree.end() && isSameContent(version, same->second);
}

/// Copies an item under a temporary name beside its destination and gives the whole copy its name. Answers
/// the versions that were copied.
SystemResult<TreeVersions> copyTo(const LocatedItem& source, const DriveEntry& target,
    const std::string& temporary, const std::string& newName)
{
    TRW_TRY(copyTree(source.entry.folder, source.name, target.folder, temporary));
    auto copied = readVersions(target.folder, temporary);
    if (!copied)
        return copied;
    TRW_TRY(renameEntry(target.folder, temporary, target.folder, newName));
    return copied;
}

Error changeError(const SystemError& failure, const std::string& path)
{
    return failure.is(changedMeanwhile) ? Error(FileErrorCode::Cancelled) : itemError(failure, path);
}

/// Creates one folder, unless it exists already, and notes it.
std::optional<Error> makeFolder(
    const DriveLayout& layout, const std::string& path, std::vector<DriveEntry>& made)
{
    auto entry = DriveEntry::open(layout, path);
    if (!entry)
        return entry.error;
    if (isReservedName(entry.value->name))
        return reservedName(path);
    auto failure = entry->checkIsFree();
    if (!failure)
        failure = SystemError::unless(::mkdirat(entry->folder.get(), entry->name.c_str(), 0777) == 0, path);
    if (failure.is(EEXIST)) {
        const auto found = entry->status();
        if (found && S_ISDIR(found->st_mode))
            return std::nullopt;
        if (!found && !found.error.is(ENOENT))
            return itemError(found.error, path);
    }
    if (!failure) {
        made.push_back(std::move(*entry.value));
        failure = syncFolder(made.back().folder);
    }
    return failure ? std::optional(itemError(failure, path)) : std::nullopt;
}

Error intoItself(const std::string& from, const std::string& to)
{
    platform::PropertyDictionary info;
    info.emplace(platform::errorKey::filePath, from);
    info.emplace(platform::errorKey::destinationFilePath, to);
    info.emplace(platform::errorKey::localizedDescription,
        host::system::translated(host::system::textKey("A folder can’t be moved into itself.")));
    return Error(platform::errorDomain::system, EINVAL, std::move(info));
}

} // namespace

std::optional<ItemVersion> LocalItemChanges::versionOfItem(const std::string& path) const
{
    const auto item = LocatedItem::locate(_layout, path);
    return item ? std::optional(versionOf(item->found)) : std::nullopt;
}

std::optional<Error> LocalItemChanges::createFolder(const std::string& path)
{
    const auto& root = _layout.documents();
    if (!path.starts_with(root + '/'))
        return itemError(EXDEV, path);
    std::vector<DriveEntry> made;
    std::optional<Error> error;
    for (auto slash = root.size(); !error && slash != std::string::npos;) {
        slash = path.find('/', slash + 1);
        error = makeFolder(_layout, path.substr(0, slash), made);
    }
    // After a failure the new folders are removed again, unless another program uses one by now.
    for (auto entry = made.rbegin(); error && entry != made.rend(); ++entry)
        ::unlinkat(entry->folder.get(), entry->name.c_str(), AT_REMOVEDIR);
    return error;
}

std::optional<Error> LocalItemChanges::removeItem(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    const auto item = LocatedItem::locate(_layout, path);
    if (!item)
        return item.error;
    if (unchangedSince && versionOf(item->found) != *unchangedSince)
        return Error(FileErrorCode::Cancelled);
    if (!item->isPromise())
        static_cast<void>(settleTwin(_layout, item->entry, *_store));
    const auto failure = removeLocated(*item);
    return failure ? std::optional(changeError(failure, path)) : std::nullopt;
}

SystemError LocalItemChanges::removeLocated(const LocatedItem& item)
{
    const auto before = readVersions(item.entry.folder, item.name);
    if (!before)
        return before.error;
    auto held = HeldItem::take(_layout, item.entry, item.name);
    if (!held)
        return held.error;
    const auto after = readVersions(held->folder(), held->name());
    if (!after)
        return after.error;
    if (*before != *after || !isStill(item, *after))
        return SystemError(changedMeanwhile, item.name);
    return held->remove(_store.get());
}

std::optional<Error> LocalItemChanges::moveItem(const std::string& from, const std::string& to)
{
    const auto source = LocatedItem::locate(_layout, from);
    const auto target = DriveEntry::open(_layout, to);
    if (!source || !target)
        return source ? target.error : source.error;
    if (isReservedName(target.value->name))
        return reservedName(to);
    if (to.starts_with(from + '/'))
        return intoItself(from, to);
    if (const auto failure = target->checkIsFree())
        return systemError(failure, from, to);
    if (!source->isPromise())
        static_cast<void>(settleTwin(_layout, source->entry, *_store));
    const auto failure = moveLocated(*source, *target.value);
    // The kernel answers EINVAL when the target lies inside the source, which a mount can hide from the
    // paths.
    if (failure.is(ownFolder) || (failure.is(EINVAL) && S_ISDIR(source->found.st_mode)))
        return intoItself(from, to);
    if (failure)
        return failure.is(changedMeanwhile) ? changeError(failure, from) : systemError(failure, from, to);
    return std::nullopt;
}

SystemError LocalItemChanges::moveLocated(const LocatedItem& source, const DriveEntry& target)
{
    const auto newName = source.isPromise() ? target.promiseName() : target.name;
    // Only the promise of a long name says it, and that in its own name and in its file, so it says both
    // names while the first of these changes.
    const bool saysName =
        source.isPromise() && (system::isLongPromiseName(source.name) || system::isLongPromiseName(newName));
    if (saysName)
        TRW_TRY(system::addPromisedName(source.entry.folder, source.name, target.name));
    auto failure = moveWithin(source, target, newName);
    if (failure.is(EXDEV))
        failure = moveAcross(source, target, newName);
    if (saysName && !failure)
        system::settlePromisedName(target.folder, newName, target.name);
    return failure;
}

SystemError LocalItemChanges::moveWithin(
    const LocatedItem& source, const DriveEntry& target, const std::string& newName)
{
    TRW_TRY(renameEntry(source.entry.folder, source.name, target.folder, newName));
    auto failure = syncFolder(target.folder);
    if (!failure)
        failure = syncFolder(source.entry.folder);
    // A move that might not survive a power cut counts as failed and is taken back.
    if (failure)
        static_cast<void>(renameEntry(target.folder, newName, source.entry.folder, source.name));
    return failure;
}

SystemError LocalItemChanges::moveAcross(
    const LocatedItem& source, const DriveEntry& target, const std::string& newName)
{
    const auto before = readVersions(source.entry.folder, source.name);
    if (!before)
        return before.error;
    if (!isStill(source, *before))
        return SystemError(changedMeanwhile, source.name);
    if (holdsFolder(*before, target.folder))
        return SystemError(ownFolder, target.path);
    const auto temporary = uniqueName(WorkRecord::temporaryPrefix);
    const auto item = system::siblingPath(source.entry.path, source.name);
    const auto working = system::siblingPath(target.path, temporary);
    const auto copy = system::siblingPath(target.path, newName);
    const auto record = WorkRecord::write(_layout, {item, working, copy});
    const auto copied = record ? copyTo(source, target, temporary, newName) : record.error;
    if (!copied) {
        static_cast<void>(removeTree(target.folder, temporary));
        return copied.error;
    }
    // From here on the copy is whole and has its name, so at worst both the copy and the original exist.
    auto failure = syncFolder(target.folder);
    if (!failure)
        failure = removeMoved(source, *before, copy);
    if (failure)
        withdraw(target, newName, *copied);
    return failure;
}

void LocalItemChanges::withdraw(const DriveEntry& target, const std::string& name, const TreeVersions& copied)
{
    // The original still exists, so the copy is removed, unless another program has changed it meanwhile:
    // such a copy holds work that the original lacks.
    auto held = HeldItem::take(_layout, target, name);
    if (!held)
        return;
    if (const auto found = readVersions(held->folder(), held->name()); found && *found == copied)
        static_cast<void>(held->remove(nullptr));
}

SystemError LocalItemChanges::removeMoved(
    const LocatedItem& source, const TreeVersions& before, const std::string& copy)
{
    auto held = HeldItem::take(_layout, source.entry, source.name, copy);
    if (!held)
        return held.error;
    const auto after = readVersions(held->folder(), held->name());
    if (!after)
        return after.error;
    if (before != *after)
        return SystemError(changedMeanwhile, source.name);
    return held->remove(nullptr);
}

} // namespace host::drive
