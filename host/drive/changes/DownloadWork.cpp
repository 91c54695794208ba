// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DownloadWork.h"

#include "host/drive/changes/HeldItem.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/PromiseFile.h"
#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/texts/Translate.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using platform::Error;
using platform::FileErrorCode;

namespace {

constexpr std::int64_t nanosecondsPerSecond = 1'000'000'000;

/// Copies the attributes and the modification date in the promise to the file.
SystemError mark(const FileDescriptor& file, const PromiseRecord& promise)
{
    const auto* const role = !promise.role ? "" : nameOf(*promise.role);
    const auto identifier = promise.documentIdentifier;
    const std::pair<const char*, std::string> marks[] = {{itemMark::tags, joinedTags(promise.tags)},
        {itemMark::shared, promise.shared ? "1" : ""}, {itemMark::role, role},
        {itemMark::documentIdentifier, identifier != 0 ? std::to_string(identifier) : ""},
        {system::hiddenExtensionAttribute, promise.extensionHidden ? "1" : ""},
        {itemMark::status, "current"}};
    for (const auto& [name, value] : marks) {
        if (!value.empty() && ::fsetxattr(file.get(), name, value.data(), value.size(), 0) != 0)
            return SystemError::last(name);
    }
    if (!promise.modified)
        return {};
    auto seconds = promise.modified->nanoseconds / nanosecondsPerSecond;
    auto rest = promise.modified->nanoseconds % nanosecondsPerSecond;
    if (rest < 0) {
        --seconds;
        rest += nanosecondsPerSecond;
    }
    const timespec times[] = {{0, UTIME_OMIT}, {seconds, rest}};
    return SystemError::unless(::futimens(file.get(), times) == 0);
}

/// A download that ended early must not take the place of the document.
SystemError checkSize(const FileDescriptor& file, const PromiseRecord& promise)
{
    struct stat found;
    if (::fstat(file.get(), &found) != 0)
        return SystemError::last();
    const bool isShort = promise.size && static_cast<std::uint64_t>(found.st_size) < *promise.size;
    return isShort ? SystemError(EIO) : SystemError();
}

/// Gives the new document the tags that its promise was given during the download.
SystemError takeNewTags(const FileDescriptor& file, const DriveEntry& entry, const PromiseRecord& promise)
{
    const auto now = readPromise(entry);
    return !now || now->tags == promise.tags ? SystemError() : writeTags(file, now->tags);
}

/// Removes the promise, or the new document when its promise was meanwhile deleted or moved away: such a
/// document must not appear in its old place again.
SystemError settlePromise(const DriveLayout& layout, const DriveEntry& entry, CloudStore& store,
    const platform::ItemVersion& published)
{
    if (statusAt(entry.folder, entry.promiseName())) {
        dropRedundantPromise(entry, store);
        return {};
    }
    if (auto held = HeldItem::take(layout, entry, entry.name)) {
        const auto found = statusAt(held->folder(), held->name());
        // A document that cannot be removed is put back, because one document too many is better than one too
        // few.
        if (found && isSameContent(published, versionOf(*found)))
            static_cast<void>(held->remove(nullptr));
    }
    return {ENOENT, entry.promiseName()};
}

SystemError fetchInto(const DriveLayout& layout, CloudStore& store, const DriveEntry& entry,
    const PromiseRecord& promise, const CloudStore::Progress& progress)
{
    auto file = NewFile::create(layout, entry);
    if (!file)
        return file.error;
    TRW_TRY(store.fetch(promise.content, file->descriptor(), progress));
    TRW_TRY(checkSize(file->descriptor(), promise));
    TRW_TRY(mark(file->descriptor(), promise));
    struct stat whole;
    if (::fstat(file->descriptor().get(), &whole) != 0)
        return SystemError::last(entry.name);
    TRW_TRY(file->publish(entry, entry.name));
    TRW_TRY(takeNewTags(file->descriptor(), entry, promise));
    return settlePromise(layout, entry, store, versionOf(whole));
}

Error missingContent(const std::string& path)
{
    return cloudError(CloudErrorCode::MissingContent, path,
        system::textKey("The content of the document isn’t in the cloud."));
}

} // namespace

std::optional<Error> bringHere(const DriveLayout& layout, CloudStore& store, const std::string& path,
    const CloudStore::Progress& progress)
{
    const auto item = LocatedItem::locate(layout, path);
    if (!item || !item->isPromise())
        return item.error;
    const auto promise = readPromise(item->entry);
    if (!promise)
        return promise.error;
    if (promise->kind != PromiseRecord::Kind::File)
        return Error(FileErrorCode::Unsupported);
    if (promise->content.empty())
        return missingContent(path);
    const auto failure = fetchInto(layout, store, item->entry, *promise, progress);
    if (!failure)
        return std::nullopt;
    // Either the promise or its content may be missing.
    if (failure.is(ENOENT) && item->entry.find())
        return missingContent(path);
    return itemError(failure, path);
}

} // namespace host::drive
