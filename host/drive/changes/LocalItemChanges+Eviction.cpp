// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file removes the downloaded copies of documents and packages, whose promises take their place.

#include "host/drive/changes/CloudStore.h"
#include "host/drive/changes/Discarding.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/ItemPaths.h"
#include "platform/Log.h"

#include <fcntl.h>

#include <algorithm>
#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;
using platform::FileErrorCode;

namespace {

/// With it the short form of a promise fits into the inode of its file.
constexpr const char* contentPrefix = "c-";

/// Finds work that is under way in a package, such as the download of a part.
class WorkSearch : public TreeVisitor {
public:
    SystemError visitItem(const FileDescriptor&, const std::string& name, const struct stat&) override
    {
        return system::isPassingName(name) ? SystemError(EBUSY, name) : SystemError();
    }
    SystemError leaveFolder(const FileDescriptor&, const std::string& name) override
    {
        return system::isPassingName(name) ? SystemError(EBUSY, name) : SystemError();
    }
};

/// Answers the bytes of a package that can come back as it is, and whose content can be removed once it has.
SystemResult<std::uint64_t> checkPackage(const DriveEntry& entry)
{
    WorkSearch search;
    TRW_TRY(walkTree(entry.folder, entry.name, search));
    TRW_TRY(checkRemovable(entry.folder, entry.name));
    return checkCopyable(entry.folder, entry.name);
}

/// Answers the versions of everything in the item that was located, or ECANCELED when another one has its
/// name by now.
SystemResult<TreeVersions> versionsOf(const LocatedItem& item)
{
    auto versions = readVersions(item.entry.folder, item.name);
    if (!versions)
        return versions;
    const auto version = versionOf(item.found);
    const auto own = versions->find({version.device, version.inode});
    const bool isStill = own != versions->end() && isSameContent(version, own->second);
    return isStill ? std::move(versions) : SystemError(ECANCELED, item.name);
}

} // namespace

std::optional<Error> LocalItemChanges::evictItem(const std::string& path)
{
    const auto item = LocatedItem::locate(_layout, path);
    if (!item || item->isPromise())
        return item.error;
    const bool isPackage = S_ISDIR(item->found.st_mode) && _isPackage(item->name);
    if (!S_ISREG(item->found.st_mode) && !isPackage)
        return Error(FileErrorCode::Unsupported);
    auto failure = settleTwin(_layout, item->entry, *_store);
    if (!failure)
        failure = replaceByPromise(*item);
    if (failure.is(ECANCELED))
        return Error(FileErrorCode::Cancelled);
    return failure ? std::optional(itemError(failure, path)) : std::nullopt;
}

SystemError LocalItemChanges::replaceByPromise(const LocatedItem& item)
{
    static constexpr platform::Operation op{"-[LocalItemChanges replaceByPromise:]"};
    const auto& entry = item.entry;
    const FileDescriptor document(::openat(
        entry.folder.get(), entry.name.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    const auto traits = document ? ItemTraits::read(document) : SystemError::last(entry.name);
    if (!traits)
        return traits.error;
    const auto versions = versionsOf(item);
    if (!versions)
        return versions.error;
    const auto content = uniqueName(contentPrefix);
    auto promise = promiseFor(document, entry.name, content);
    if (promise.kind == PromiseRecord::Kind::Package) {
        const auto bytes = checkPackage(entry);
        if (!bytes)
            return bytes.error;
        promise.size = *bytes;
    }
    auto file = NewFile::create(_layout, entry, content);
    if (!file)
        return file.error;
    TRW_TRY(writePromise(file->descriptor(), promise));
    TRW_TRY(traits->ofPromise().write(file->descriptor()));
    // While both exist the document counts. Both names change in one journal, in this order, so one sync at
    // the end is enough.
    TRW_TRY(file->publish(entry, entry.promiseName(), NewFile::Sync::Nothing));
    auto failure = _store->store(entry, *versions, content);
    if (failure) {
        // A promise that cannot be taken back is taken back by the next start.
        if (withdrawPromise(_layout, entry, *_store, content))
            file->keepRecord();
        return failure;
    }
    const auto now = ItemTraits::read(document);
    const auto missed = now ? now->writeChanges(*traits, file->descriptor()) : now.error;
    if (missed)
        op.warning("Cannot give the promise of %@ what has changed meanwhile: %@", entry.path, missed);
    // The document is in the cloud by now, whether or not its folder can be opened for a sync of its own.
    static_cast<void>(syncFolder(entry.folder));
    return SystemError::unless(::fsync(file->descriptor().get()) == 0, entry.name);
}

} // namespace host::drive
