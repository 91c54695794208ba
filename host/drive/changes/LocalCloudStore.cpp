// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"

#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/SmallFile.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

bool isPlainName(const std::string& name)
{
    return !name.empty() && name != "." && name != ".."
        && name.find_first_of(std::string_view("/\0", 2)) == std::string::npos;
}

SystemResult<FileDescriptor> openStore(const std::string& path)
{
    FileDescriptor folder(::open(path.c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!folder)
        return SystemError::last(path);
    return folder;
}

/// Answers ECANCELED when what was moved into the store has other versions.
SystemError checkStored(
    const FileDescriptor& folder, const std::string& content, const TreeVersions& versions)
{
    const auto stored = readVersions(folder, content);
    if (!stored)
        return stored.error;
    return *stored == versions ? SystemError() : SystemError(ECANCELED, content);
}

} // namespace

SystemResult<FileDescriptor> LocalCloudStore::openContent(const std::string& content) const
{
    if (!isPlainName(content))
        return SystemError(ENOENT, content);
    SystemError failure(ENOENT, content);
    for (const auto& path : {_layout.cloud(), _layout.released()}) {
        const auto folder = openStore(path);
        constexpr int flags = O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;
        FileDescriptor file(folder ? ::openat(folder->get(), content.c_str(), flags) : -1);
        if (file)
            return file;
        failure = folder ? SystemError::last(content) : folder.error;
        if (!failure.is(ENOENT))
            break;
    }
    return failure;
}

SystemError LocalCloudStore::fetch(
    const std::string& content, const FileDescriptor& into, const Progress& progress)
{
    const auto from = openContent(content);
    if (!from)
        return from.error;
    struct stat found, target;
    if (::fstat(from->get(), &found) != 0 || ::fstat(into.get(), &target) != 0)
        return SystemError::last(content);
    const bool isFolder = S_ISDIR(found.st_mode);
    if ((!isFolder && !S_ISREG(found.st_mode)) || isFolder != S_ISDIR(target.st_mode))
        return {EOPNOTSUPP, content};
    const auto total = isFolder ? checkCopyable(*from, ".")
                                : SystemResult<std::uint64_t>(static_cast<std::uint64_t>(found.st_size));
    if (!total)
        return total.error;
    std::uint64_t done = 0;
    const CopyProgress copied = [&](std::uint64_t bytes) {
        done = bytes;
        return progress(bytes, *total) == Continue::Yes ? SystemError() : SystemError(ECANCELED, content);
    };
    TRW_TRY(isFolder ? copyContents(*from, into, copied) : copyBytes(*from, into, copied));
    return done < *total ? SystemError(EIO, content) : SystemError();
}

SystemError LocalCloudStore::store(
    const DriveEntry& document, const TreeVersions& versions, const std::string& content)
{
    const auto folder = openOwnFolder(_layout.cloud());
    if (!folder)
        return folder.error;
    TRW_TRY(renameEntry(document.folder, document.name, *folder, content));
    // A power cut that takes this rename leaves the document in its place, where it hides its promise.
    auto failure = checkStored(*folder, content, versions);
    // When the file cannot be given its old name back, it stays in the store as a content.
    if (failure)
        static_cast<void>(renameEntry(*folder, content, document.folder, document.name));
    return failure;
}

SystemError LocalCloudStore::release(const std::string& content)
{
    if (!isPlainName(content))
        return {};
    const auto folder = openStore(_layout.cloud());
    if (!folder)
        return folder.error.is(ENOENT) ? SystemError() : folder.error;
    const auto released = openOwnFolder(_layout.released());
    const auto failure = released ? renameEntry(*folder, content, *released, content) : released.error;
    // A content on another storage stays where it is, and shows as a content without a promise.
    const bool isDone = !failure || failure.is(ENOENT) || failure.is(EEXIST) || failure.is(EXDEV);
    if (isDone)
        _released();
    return isDone ? SystemError() : failure;
}

std::optional<bool> LocalCloudStore::has(const std::string& content)
{
    const auto file = openContent(content);
    if (file)
        return true;
    return file.error.is(ENOENT) ? std::optional(false) : std::nullopt;
}

bool LocalCloudStore::holdsOtherThan(const std::string& content, const FileDescriptor& document)
{
    const auto file = openContent(content);
    struct stat found;
    if (file && ::fstat(document.get(), &found) == 0 && S_ISDIR(found.st_mode))
        return !isSameTree(*file, document);
    return file ? static_cast<bool>(compareBytes(*file, document)) : !file.error.is(ENOENT);
}

platform::Result<StorageSpace> LocalCloudStore::quota()
{
    return StorageSpace::of(_layout.home());
}

} // namespace host::drive
