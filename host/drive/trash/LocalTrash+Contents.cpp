// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file lists, restores and removes contents in the cloud without a promise.

#include "host/drive/changes/CloudStore.h"
#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/SmallFile.h"
#include "host/drive/trash/LocalTrash.h"
#include "host/drive/trash/TrashedContent.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"
#include "platform/Log.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using platform::Error;
using platform::Result;
using platform::TrashedItem;

namespace {

/// No item in the trash has such a name.
constexpr std::string_view contentPrefix = ".trwcontent-";

std::string nameOfContents()
{
    return host::system::translated(host::system::textKey("Recovered document"));
}

} // namespace

std::optional<std::string> contentIn(const std::string& identifier)
{
    const bool isContent = identifier.starts_with(contentPrefix) && identifier.size() > contentPrefix.size()
        && identifier.find_first_of(std::string_view("/\0", 2)) == std::string::npos;
    return isContent ? std::optional(identifier.substr(contentPrefix.size())) : std::nullopt;
}

std::vector<TrashedItem> LocalTrash::contentsWithoutPromise()
{
    static constexpr platform::Operation op{"-[LocalTrash contentsWithoutPromise]"};
    constexpr int share = 20;
    const std::lock_guard lock(_mutex);
    const auto begin = std::chrono::steady_clock::now();
    if (begin >= _nextSearch) {
        auto found = ContentCollection(_layout).orphans();
        const auto end = std::chrono::steady_clock::now();
        _nextSearch = end + share * (end - begin);
        if (found)
            _contents = std::move(*found);
        else
            op.warning("Cannot look for contents without a promise: %@", found.error);
    }
    std::vector<TrashedItem> items;
    const FileDescriptor cloud(
        ::open(_layout.cloud().c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    for (const auto& content : _contents) {
        const auto found = cloud ? statusAt(cloud, content) : SystemError(ENOENT, content);
        if (!found || (!S_ISREG(found->st_mode) && !S_ISDIR(found->st_mode)))
            continue;
        TrashedItem item;
        item.identifier = std::string(contentPrefix) + content;
        item.name = nameOfContents();
        item.isPromise = true;
        item.type = system::fileType(found->st_mode);
        item.size = checkCopyable(cloud, content).value;
        item.reason = TrashedItem::Reason::ContentWithoutPromise;
        items.push_back(std::move(item));
    }
    return items;
}

void LocalTrash::forgetContent(const std::string& content)
{
    const std::lock_guard lock(_mutex);
    _contents.erase(content);
}

Result<std::string> LocalTrash::restoreContent(
    const std::string& content, const std::optional<std::string>& target)
{
    const auto path = target.value_or(_layout.defaultContainer() + '/'
        + std::string(DriveLayout::documentsFolderName) + '/' + nameOfContents());
    if (auto error = _changes->createFolder(system::parentPath(path)))
        return *std::move(error);
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return *entry.error;
    if (isReservedName(entry.value->name))
        return reservedName(path);
    if (const auto failure = promiseContent(*entry.value, content))
        return failure.is(ESTALE) ? notInTrash() : itemError(failure, path);
    forgetContent(content);
    return path;
}

/// Makes the promise of a content, with the traits that the document had when its content came into the
/// cloud.
SystemError LocalTrash::promiseContent(const DriveEntry& entry, const std::string& content) const
{
    TRW_TRY(entry.checkIsFree());
    const auto cloud = openOwnFolder(_layout.cloud());
    if (!cloud)
        return cloud.error;
    const FileDescriptor document(
        ::openat(cloud->get(), content.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (!document)
        return errno == ENOENT ? SystemError(ESTALE, content) : SystemError::last(content);
    const auto traits = ItemTraits::read(document);
    if (!traits)
        return traits.error;
    auto promise = promiseFor(document, entry.name, content);
    if (promise.kind == PromiseRecord::Kind::Package)
        promise.size = checkCopyable(*cloud, content).value;
    auto file = NewFile::create(_layout, entry, content);
    if (!file)
        return file.error;
    TRW_TRY(writePromise(file->descriptor(), promise));
    TRW_TRY(traits->ofPromise().write(file->descriptor()));
    return file->publish(entry, entry.promiseName());
}

std::optional<Error> LocalTrash::removeContent(const std::string& content)
{
    // One that was released is gone from the trash, though it can still be fetched.
    const auto cloud = openOwnFolder(_layout.cloud());
    const auto found = cloud ? statusAt(*cloud, content) : cloud.error;
    if (!found)
        return found.error.is(ENOENT) ? notInTrash() : itemError(found.error, content);
    if (const auto failure = _store->release(content))
        return itemError(failure, content);
    forgetContent(content);
    return std::nullopt;
}

} // namespace host::drive
