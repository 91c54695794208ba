// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file changes the tags of items and of promises.

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>

#include <algorithm>
#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;
using platform::FileErrorCode;
using platform::Result;

namespace {

using Tags = std::vector<std::string>;

/// Answers ECANCELED when another program has put another file in the place of the one that was changed.
SystemError checkIsStillThere(const FileDescriptor& file)
{
    struct stat now;
    if (::fstat(file.get(), &now) != 0)
        return SystemError::last();
    return now.st_nlink == 0 ? SystemError(ECANCELED) : SystemError();
}

/// Answers the tags that an item shall have. A tag that cannot be kept is EINVAL.
SystemResult<Tags> edited(const Tags& before, const platform::FileChanges::TagEdit& edit)
{
    Tags tags;
    for (auto& tag : edit(before)) {
        if (!platform::isTag(tag) && std::ranges::find(before, tag) == before.end())
            return SystemError(EINVAL, tag);
        if (std::ranges::find(tags, tag) == tags.end())
            tags.push_back(std::move(tag));
    }
    return tags;
}

SystemResult<Tags> editItem(const DriveEntry& entry, const platform::FileChanges::TagEdit& edit)
{
    // The item stays open, so a new name does not lead to another item.
    const FileDescriptor file(
        ::openat(entry.folder.get(), entry.name.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
    struct stat found;
    if (!file || ::fstat(file.get(), &found) != 0)
        return SystemError::last();
    if (!S_ISREG(found.st_mode) && !S_ISDIR(found.st_mode))
        return SystemError(ENOTSUP);
    auto before = tagsOf(file);
    const auto tags = edited(before, edit);
    if (!tags)
        return tags.error;
    if (*tags == before)
        return before;
    TRW_TRY(writeTags(file, *tags));
    TRW_TRY(checkIsStillThere(file));
    return before;
}

SystemResult<Tags> editPromise(
    const DriveLayout& layout, const DriveEntry& entry, const platform::FileChanges::TagEdit& edit)
{
    const auto name = entry.promiseName();
    constexpr int flags = O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;
    const FileDescriptor file(::openat(entry.folder.get(), name.c_str(), flags));
    struct stat found;
    if (!file || ::fstat(file.get(), &found) != 0)
        return SystemError::last();
    const auto text = readSmallFile(file, entry.path, PromiseRecord::maximumFileSize);
    auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    if (!promise)
        return SystemError(EBADMSG);
    auto before = promise->tags;
    auto tags = edited(before, edit);
    if (!tags)
        return tags.error;
    if (*tags == before)
        return before;
    promise->tags = std::move(*tags);
    const auto changed = promise->toJson();
    if (changed.size() > PromiseRecord::maximumFileSize)
        return SystemError(E2BIG);
    const DriveEntry place{FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0)), name,
        system::siblingPath(entry.path, name)};
    auto fresh = NewFile::create(layout, place);
    if (!fresh)
        return fresh.error;
    TRW_TRY(fresh->write(changed));
    TRW_TRY(SystemError::unless(::fchmod(fresh->descriptor().get(), found.st_mode & 07777) == 0));
    if (const auto replaced = fresh->replace(layout, place, versionOf(found)); !replaced)
        return replaced.error;
    return before;
}

/// Answers whether another program has changed the item between two steps, so that a new attempt may succeed.
bool isWorthAnotherTry(const SystemError& failure)
{
    return failure.is(ECANCELED) || failure.is(ENOENT);
}

Error tagError(const SystemError& failure, const std::string& path)
{
    if (failure.is(EINVAL))
        return Error(FileErrorCode::InvalidName);
    if (failure.is(ENOTSUP) || failure.is(EPERM))
        return Error(FileErrorCode::Unsupported);
    if (failure.is(EBADMSG))
        return damagedRecord(path, "its promise is no JSON object");
    return itemError(isWorthAnotherTry(failure) ? SystemError(EBUSY) : failure, path);
}

} // namespace

Result<Tags> LocalItemChanges::editTags(const std::string& path, const TagEdit& edit)
{
    constexpr int mostTries = 3;
    SystemError failure;
    for (int tries = 0; tries < mostTries; ++tries) {
        const auto item = LocatedItem::locate(_layout, path);
        if (!item)
            return *item.error;
        auto before =
            item->isPromise() ? editPromise(_layout, item->entry, edit) : editItem(item->entry, edit);
        if (before)
            return std::move(*before);
        failure = before.error;
        if (!isWorthAnotherTry(failure))
            break;
    }
    return tagError(failure, path);
}

} // namespace host::drive
