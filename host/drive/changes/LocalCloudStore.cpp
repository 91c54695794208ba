// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/LocalCloudStore.h"

#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DirectoryReader.h"

#include <fcntl.h>

#include <cerrno>
#include <memory>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using platform::ItemVersion;

namespace {

bool isPlainName(const std::string& name)
{
    return !name.empty() && name != "." && name != ".."
        && name.find_first_of(std::string_view("/\0", 2)) == std::string::npos;
}

/// ECANCELED when what was moved into the store is another version by now.
SystemError checkStored(const FileDescriptor& folder, const std::string& content, const ItemVersion& version)
{
    const auto stored = statusAt(folder, content);
    if (!stored)
        return stored.error;
    return isSameContent(version, versionOf(*stored)) ? SystemError() : SystemError(ECANCELED, content);
}

} // namespace

FileDescriptor LocalCloudStore::openFolder() const
{
    return FileDescriptor(::open(_layout.cloud().c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
}

FileDescriptor LocalCloudStore::openContent(const std::string& content) const
{
    if (!isPlainName(content)) {
        errno = ENOENT;
        return {};
    }
    // Why the folder cannot be had stays in errno: only what is missing is nothing.
    const auto folder = openFolder();
    return folder ? FileDescriptor(::openat(
               folder.get(), content.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC))
                  : FileDescriptor();
}

int LocalCloudStore::fetch(const std::string& content, const FileDescriptor& into, const Progress& progress)
{
    const auto from = openContent(content);
    struct stat found;
    if (!from || ::fstat(from.get(), &found) != 0)
        return errno;
    if (!S_ISREG(found.st_mode))
        return EOPNOTSUPP;
    const auto total = static_cast<std::uint64_t>(found.st_size);
    std::uint64_t done = 0;
    const int failure = copyBytes(from, into, [&](std::uint64_t copied) {
        done = copied;
        return progress(copied, total) == Continue::Yes ? SystemError() : SystemError(ECANCELED, content);
    });
    return failure != 0 ? failure : done < total ? EIO : 0;
}

int LocalCloudStore::store(const DriveEntry& document, const ItemVersion& version, const std::string& content)
{
    const auto folder = openOwnFolder(_layout.cloud());
    if (!folder)
        return folder.error;
    TRW_TRY(renameEntry(document.folder, document.name, *folder, content));
    auto failure = checkStored(*folder, content, version);
    if (!failure)
        failure = syncFolder(*folder);
    // Where it cannot come back to its name it stays a content.
    if (failure)
        static_cast<void>(renameEntry(*folder, content, document.folder, document.name));
    return failure;
}

int LocalCloudStore::remove(const std::string& content)
{
    if (!isPlainName(content))
        return 0;
    const auto folder = openFolder();
    return (folder && ::unlinkat(folder.get(), content.c_str(), 0) == 0) || errno == ENOENT ? 0 : errno;
}

int LocalCloudStore::move(const std::string& content, const std::string& newContent)
{
    if (!isPlainName(content) || !isPlainName(newContent))
        return ENOENT;
    const auto folder = openFolder();
    if (!folder)
        return errno;
    return renameEntry(folder, content, folder, newContent);
}

bool LocalCloudStore::holdsOtherThan(const std::string& content, const FileDescriptor& document)
{
    const auto file = openContent(content);
    return file ? static_cast<bool>(compareBytes(file, document)) : errno != ENOENT;
}

platform::Result<std::vector<std::string>> LocalCloudStore::listChanges(platform::Date since)
{
    std::vector<std::string> names;
    const auto folder = system::openFolder(_layout.cloud());
    if (!folder && errno != ENOENT)
        return itemError(errno, _layout.cloud());
    if (!folder)
        return names;
    const auto reader = std::make_unique<system::DirectoryReader>(folder);
    while (const auto entry = reader->next()) {
        struct stat found;
        // A rename into the folder sets the time of change and leaves that of the content.
        if (::fstatat(folder.get(), entry->name.data(), &found, AT_SYMLINK_NOFOLLOW) == 0
            && versionOf(found).changed >= since.nanoseconds)
            names.emplace_back(entry->name);
    }
    if (reader->errorNumber() != 0)
        return itemError(reader->errorNumber(), _layout.cloud());
    return names;
}

platform::Result<StorageSpace> LocalCloudStore::quota()
{
    return StorageSpace::of(_layout.home());
}

} // namespace host::drive
