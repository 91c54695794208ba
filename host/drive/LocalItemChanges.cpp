#include "host/drive/LocalItemChanges.h"

#include "host/drive/BeneathRoot.h"
#include "host/drive/HeldItem.h"
#include "host/drive/ItemFacts.h"
#include "host/drive/PromiseRecord.h"
#include "host/drive/SmallFile.h"
#include "host/drive/TreeWalk.h"
#include "host/system/AtomicWrite.h"
#include "host/system/SystemErrors.h"
#include "host/system/Translate.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::systemError;
using platform::Error;
using platform::FileErrorCode;
using platform::ItemVersion;

namespace {

bool isPlainName(const std::string& name)
{
    return !name.empty() && name != "." && name != ".."
        && name.find_first_of(std::string_view("/\0", 2)) == std::string::npos;
}

/// Whether an item or a promise has the name already; answers 0 when none has, EEXIST, or another errno.
int checkIsFree(const DriveEntry& entry)
{
    std::string name;
    struct stat found;
    const int failure = entry.find(name, found);
    return failure == ENOENT ? 0 : failure == 0 ? EEXIST : failure;
}

PromiseRecord promiseFor(const ItemFacts& facts, const std::string& content)
{
    PromiseRecord promise;
    const auto date = [](const statx_timestamp& time) {
        return platform::Date{time.tv_sec * 1'000'000'000 + time.tv_nsec};
    };
    promise.size = facts.status.stx_size;
    promise.modified = facts.modified();
    if (facts.status.stx_mask & STATX_BTIME)
        promise.created = date(facts.status.stx_btime);
    promise.shared = facts.marks.shared;
    promise.role = facts.marks.role;
    promise.extensionHidden = facts.marks.extensionHidden;
    promise.documentIdentifier = facts.marks.documentIdentifier;
    promise.tags = facts.marks.tags;
    promise.content = content;
    return promise;
}

/// What "changed meanwhile" is called between the steps below; no step of theirs fails with it otherwise.
constexpr int changedMeanwhile = ECANCELED;

Error changeError(int errorNumber, const std::string& path)
{
    return errorNumber == changedMeanwhile ? Error(FileErrorCode::Cancelled) : itemError(errorNumber, path);
}

/// Answers 0, changedMeanwhile when another version had to be put back, or another errno.
int moveToCloud(const DriveEntry& entry, const ItemVersion& version, const FileDescriptor& cloud,
    const std::string& content)
{
    struct stat moved;
    if (const int failure = renameEntry(entry.folder, entry.name, cloud, content); failure != 0)
        return failure;
    if (::fstatat(cloud.get(), content.c_str(), &moved, AT_SYMLINK_NOFOLLOW) == 0
        && isSameContent(version, versionOf(moved)))
        return 0;
    const int failure = renameEntry(cloud, content, entry.folder, entry.name);
    return failure == 0 ? changedMeanwhile : failure;
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
    const auto entry = DriveEntry::open(_layout, path);
    std::string name;
    struct stat found;
    if (!entry || entry->find(name, found) != 0)
        return std::nullopt;
    return versionOf(found);
}

std::optional<Error> LocalItemChanges::createFolder(const std::string& path)
{
    const auto& root = _layout.documents();
    if (!path.starts_with(root + '/'))
        return itemError(EXDEV, path);
    for (auto slash = path.find('/', root.size() + 1);; slash = path.find('/', slash + 1)) {
        const bool isLast = slash == std::string::npos;
        const auto entry = DriveEntry::open(_layout, path.substr(0, slash));
        if (!entry)
            return entry.error;
        struct stat found;
        int failure = checkIsFree(*entry);
        if (failure == 0 && ::mkdirat(entry->folder.get(), entry->name.c_str(), 0777) != 0)
            failure = errno;
        else if (failure == 0)
            failure = syncFolder(entry->folder);
        if (failure == EEXIST && entry->status(found) == 0 && S_ISDIR(found.st_mode))
            failure = 0;
        if (failure != 0 || isLast)
            return failure == 0 ? std::nullopt : std::optional(itemError(failure, entry->path));
    }
}

std::optional<Error> LocalItemChanges::removeItem(
    const std::string& path, const std::optional<ItemVersion>& unchangedSince)
{
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return entry.error;
    std::string name;
    struct stat found;
    if (const int failure = entry->find(name, found); failure != 0)
        return itemError(failure, path);
    if (unchangedSince && versionOf(found) != *unchangedSince)
        return Error(FileErrorCode::Cancelled);
    const auto content = cloudContent(*entry);
    if (const int failure = removeHeld(*entry, name, versionOf(found)); failure != 0)
        return changeError(failure, path);
    removePromise(*entry, content);
    const int failure = syncFolder(entry->folder);
    return failure == 0 ? std::nullopt : std::optional(itemError(failure, path));
}

int LocalItemChanges::removeHeld(const DriveEntry& entry, const std::string& name, const ItemVersion& version)
{
    std::optional<HeldItem> held;
    if (const int failure = HeldItem::take(_layout, entry, name, held); failure != 0)
        return failure;
    struct stat found;
    if (::fstatat(held->folder().get(), held->name().c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
        return errno;
    return isSameContent(version, versionOf(found)) ? held->remove() : changedMeanwhile;
}

std::string LocalItemChanges::cloudContent(const DriveEntry& entry) const
{
    const auto text = host::system::readWholeFile(
        entry.folder, entry.promiseName(), PromiseRecord::maximumFileSize, entry.path);
    const auto promise = text ? PromiseRecord::parse(*text) : std::nullopt;
    return promise && isPlainName(promise->content) ? promise->content : std::string();
}

void LocalItemChanges::removePromise(const DriveEntry& entry, const std::string& content)
{
    // Left behind, it would make the item that was just removed show again.
    ::unlinkat(entry.folder.get(), entry.promiseName().c_str(), 0);
    if (!content.empty()) {
        const FileDescriptor cloud(::open(_layout.cloud().c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
        ::unlinkat(cloud.get(), content.c_str(), 0);
    }
}

std::optional<Error> LocalItemChanges::moveItem(const std::string& from, const std::string& to)
{
    const auto source = DriveEntry::open(_layout, from);
    const auto target = DriveEntry::open(_layout, to);
    if (!source || !target)
        return source ? target.error : source.error;
    std::string name;
    struct stat found;
    if (const int failure = source->find(name, found); failure != 0)
        return itemError(failure, from);
    if (to.starts_with(from + '/'))
        return intoItself(from, to);
    if (const int failure = checkIsFree(*target); failure != 0)
        return systemError(failure, from, to);
    const bool isPromise = name != source->name;
    const auto newName = isPromise ? target->promiseName() : target->name;
    int failure = renameEntry(source->folder, name, target->folder, newName);
    if (failure == EXDEV)
        failure = moveAcross(*source, name, *target, newName);
    if (failure != 0)
        return failure == changedMeanwhile ? changeError(failure, from) : systemError(failure, from, to);
    if (!isPromise)
        renameEntry(source->folder, source->promiseName(), target->folder, target->promiseName());
    for (const auto* entry : {&*target, &*source}) {
        if (failure = syncFolder(entry->folder); failure != 0)
            return itemError(failure, entry->path);
    }
    return std::nullopt;
}

int LocalItemChanges::moveAcross(
    const DriveEntry& source, const std::string& name, const DriveEntry& target, const std::string& newName)
{
    const auto temporary = uniqueName(".trwtmp-");
    TreeVersions before, after;
    int failure = readVersions(source.folder, name, before);
    if (failure == 0)
        failure = copyTree(source.folder, name, target.folder, temporary);
    if (failure == 0)
        failure = renameEntry(target.folder, temporary, target.folder, newName);
    if (failure != 0) {
        removeTree(target.folder, temporary);
        return failure;
    }
    if (failure = syncFolder(target.folder); failure != 0)
        return failure;
    // From here on the copy is whole and has its name: the worst that can be is that both are there.
    std::optional<HeldItem> held;
    failure = HeldItem::take(_layout, source, name, held);
    if (failure == 0)
        failure = readVersions(held->folder(), held->name(), after);
    if (failure == 0)
        failure = before == after ? held->remove() : changedMeanwhile;
    return failure;
}

std::optional<Error> LocalItemChanges::evictItem(const std::string& path)
{
    const auto entry = DriveEntry::open(_layout, path);
    if (!entry)
        return entry.error;
    std::string name;
    struct stat found;
    if (const int failure = entry->find(name, found); failure != 0)
        return itemError(failure, path);
    if (name != entry->name)
        return std::nullopt;
    if (!S_ISREG(found.st_mode))
        return Error(FileErrorCode::Unsupported);
    return replaceByPromise(*entry, found);
}

std::optional<Error> LocalItemChanges::replaceByPromise(const DriveEntry& entry, const struct stat& status)
{
    const auto cloud = openOwnFolder(_layout.cloud());
    if (!cloud)
        return itemError(errno, _layout.cloud());
    const auto content = uniqueName("content-");
    const auto promise = promiseFor(lookAtFile(descriptorPath(entry.folder) + '/' + entry.name), content);
    // While both are there the document counts; it goes only when its promise is safe on the disk.
    if (auto error = host::system::writeFileAtomically(
            entry.folder, entry.promiseName(), promise.toJson(), entry.path))
        return error;
    int failure = moveToCloud(entry, versionOf(status), cloud, content);
    if (failure != 0)
        ::unlinkat(entry.folder.get(), entry.promiseName().c_str(), 0);
    else if (failure = syncFolder(cloud); failure == 0)
        failure = syncFolder(entry.folder);
    return failure == 0 ? std::nullopt : std::optional(changeError(failure, entry.path));
}

} // namespace host::drive
