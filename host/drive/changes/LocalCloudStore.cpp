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
using host::system::SystemResult;
using platform::ItemVersion;

namespace {

bool isPlainName(const std::string& name)
{
    return !name.empty() && name != "." && name != ".."
        && name.find_first_of(std::string_view("/\0", 2)) == std::string::npos;
}

/// Answers ECANCELED when the file that was moved into the store is another version.
SystemError checkStored(const FileDescriptor& folder, const std::string& content, const ItemVersion& version)
{
    const auto stored = statusAt(folder, content);
    if (!stored)
        return stored.error;
    return isSameContent(version, versionOf(*stored)) ? SystemError() : SystemError(ECANCELED, content);
}

} // namespace

SystemResult<FileDescriptor> LocalCloudStore::openFolder() const
{
    const auto path = _layout.cloud();
    FileDescriptor folder(::open(path.c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!folder)
        return SystemError::last(path);
    return folder;
}

SystemResult<FileDescriptor> LocalCloudStore::openContent(const std::string& content) const
{
    if (!isPlainName(content))
        return SystemError(ENOENT, content);
    const auto folder = openFolder();
    if (!folder)
        return folder.error;
    constexpr int flags = O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;
    FileDescriptor file(::openat(folder->get(), content.c_str(), flags));
    if (!file)
        return SystemError::last(content);
    return file;
}

SystemError LocalCloudStore::fetch(
    const std::string& content, const FileDescriptor& into, const Progress& progress)
{
    const auto from = openContent(content);
    if (!from)
        return from.error;
    struct stat found;
    if (::fstat(from->get(), &found) != 0)
        return SystemError::last(content);
    if (!S_ISREG(found.st_mode))
        return {EOPNOTSUPP, content};
    const auto total = static_cast<std::uint64_t>(found.st_size);
    std::uint64_t done = 0;
    TRW_TRY(copyBytes(*from, into, [&](std::uint64_t copied) {
        done = copied;
        return progress(copied, total) == Continue::Yes ? SystemError() : SystemError(ECANCELED, content);
    }));
    return done < total ? SystemError(EIO, content) : SystemError();
}

SystemError LocalCloudStore::store(
    const DriveEntry& document, const ItemVersion& version, const std::string& content)
{
    const auto folder = openOwnFolder(_layout.cloud());
    if (!folder)
        return folder.error;
    TRW_TRY(renameEntry(document.folder, document.name, *folder, content));
    auto failure = checkStored(*folder, content, version);
    if (!failure)
        failure = syncFolder(*folder);
    // When the file cannot be given its old name back, it stays in the store as a content.
    if (failure)
        static_cast<void>(renameEntry(*folder, content, document.folder, document.name));
    return failure;
}

SystemError LocalCloudStore::remove(const std::string& content)
{
    if (!isPlainName(content))
        return {};
    const auto folder = openFolder();
    if (!folder)
        return folder.error.is(ENOENT) ? SystemError() : folder.error;
    const bool isGone = ::unlinkat(folder->get(), content.c_str(), 0) == 0 || errno == ENOENT;
    return SystemError::unless(isGone, content);
}

SystemError LocalCloudStore::move(const std::string& content, const std::string& newContent)
{
    if (!isPlainName(content) || !isPlainName(newContent))
        return {ENOENT, content};
    const auto folder = openFolder();
    if (!folder)
        return folder.error;
    return renameEntry(*folder, content, *folder, newContent);
}

bool LocalCloudStore::holdsOtherThan(const std::string& content, const FileDescriptor& document)
{
    const auto file = openContent(content);
    return file ? static_cast<bool>(compareBytes(*file, document)) : !file.error.is(ENOENT);
}

platform::Result<std::vector<std::string>> LocalCloudStore::listChanges(platform::Date since)
{
    std::vector<std::string> names;
    const auto folder = system::openFolder(_layout.cloud());
    if (!folder && !folder.error.is(ENOENT))
        return itemError(folder.error, _layout.cloud());
    if (!folder)
        return names;
    const auto reader = std::make_unique<system::DirectoryReader>(*folder);
    while (const auto entry = reader->next()) {
        struct stat found;
        // A rename into the folder sets the status change time and leaves the modification time.
        // The reader's names end with a null character.
        // NOLINTNEXTLINE(bugprone-suspicious-stringview-data-usage)
        if (::fstatat(folder->get(), entry->name.data(), &found, AT_SYMLINK_NOFOLLOW) == 0
            && versionOf(found).changed >= since.nanoseconds)
            names.emplace_back(entry->name);
    }
    if (reader->error())
        return itemError(reader->error(), _layout.cloud());
    return names;
}

platform::Result<StorageSpace> LocalCloudStore::quota()
{
    return StorageSpace::of(_layout.home());
}

} // namespace host::drive
