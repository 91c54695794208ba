// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file changes the tags of items and of promises.

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/SmallFile.h"

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
    const bool isReplaced = ::fstat(file.get(), &now) == 0 && now.st_nlink == 0;
    return isReplaced ? SystemError(ECANCELED) : SystemError();
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

/// An open item, or an open promise, and the tags that it has.
struct TaggedItem {
    FileDescriptor file;
    Tags tags;
    WithoutTags without = WithoutTags::NoAttribute;
};

SystemResult<TaggedItem> openItem(const DriveEntry& entry)
{
    // The item stays open, so a new name does not lead to another item.
    FileDescriptor file(::openat(entry.folder.get(), entry.name.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
    struct stat found;
    if (!file || ::fstat(file.get(), &found) != 0)
        return SystemError::last();
    if (!S_ISREG(found.st_mode) && !S_ISDIR(found.st_mode))
        return SystemError(ENOTSUP);
    const auto tags = AttributeReader(file).value(itemMark::tags);
    if (!tags)
        return tags.error;
    return TaggedItem{std::move(file), splitTags(tags->value_or(std::string()))};
}

SystemResult<TaggedItem> openTaggedPromise(const DriveEntry& entry)
{
    auto promise = OpenPromise::open(entry);
    if (!promise)
        return promise.error;
    return TaggedItem{std::move(promise->file), std::move(promise->record.tags), WithoutTags::EmptyAttribute};
}

SystemResult<Tags> editItem(const LocatedItem& located, const platform::FileChanges::TagEdit& edit)
{
    auto item = located.isPromise() ? openTaggedPromise(located.entry) : openItem(located.entry);
    if (!item)
        return item.error;
    const auto tags = edited(item->tags, edit);
    if (!tags)
        return tags.error;
    if (*tags == item->tags)
        return std::move(item->tags);
    TRW_TRY(writeTags(item->file, *tags, item->without));
    // Tags are done when they outlive a power cut. An item that cannot be opened has them all the same.
    const FileDescriptor open(
        ::open(descriptorPath(item->file).c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (open)
        ::fsync(open.get());
    TRW_TRY(checkIsStillThere(item->file));
    return std::move(item->tags);
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
        auto before = editItem(*item.value, edit);
        if (before)
            return std::move(*before);
        failure = before.error;
        if (!isWorthAnotherTry(failure))
            break;
    }
    return tagError(failure, path);
}

} // namespace host::drive
