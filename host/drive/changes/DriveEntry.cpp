// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DriveEntry.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"
#include "platform/Localization.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::Error;
using platform::ItemVersion;
using platform::Result;

namespace {

/// A file has both names for a moment, and the new one is never another item's.
SystemError renameByLink(
    const FileDescriptor& from, const std::string& name, const FileDescriptor& to, const std::string& newName)
{
    if (::linkat(from.get(), name.c_str(), to.get(), newName.c_str(), 0) != 0) {
        const bool isImpossible = errno == EPERM || errno == ENOSYS || errno == EOPNOTSUPP;
        return isImpossible ? SystemError(EOPNOTSUPP, name) : SystemError::last(name);
    }
    if (::unlinkat(from.get(), name.c_str(), 0) == 0)
        return {};
    auto failure = SystemError::last(name);
    ::unlinkat(to.get(), newName.c_str(), 0);
    return failure;
}

/// A folder replaces an empty one, and that is the one that was made here: what another program puts into it
/// keeps it (ENOTEMPTY).
SystemError renameFolderByClaim(
    const FileDescriptor& from, const std::string& name, const FileDescriptor& to, const std::string& newName)
{
    if (::mkdirat(to.get(), newName.c_str(), S_IRWXU) != 0)
        return SystemError::last(newName);
    if (::renameat(from.get(), name.c_str(), to.get(), newName.c_str()) == 0)
        return {};
    auto failure = SystemError::last(name);
    ::unlinkat(to.get(), newName.c_str(), AT_REMOVEDIR);
    return failure;
}

} // namespace

Result<DriveEntry> DriveEntry::open(const DriveLayout& layout, const std::string& path)
{
    const auto& root = layout.documents();
    if (path.find('\0') != std::string::npos)
        return itemError(EILSEQ, path);
    if (!path.starts_with(root + '/') || path.size() == root.size() + 1)
        return itemError(EXDEV, path);
    const auto slash = path.rfind('/');
    const auto parent = slash == root.size() ? "." : path.substr(root.size() + 1, slash - root.size() - 1);
    auto name = path.substr(slash + 1);
    if (name.empty() || name == "." || name == "..")
        return itemError(EINVAL, path);
    auto folder = openBeneath(root, parent, O_PATH | O_DIRECTORY);
    if (!folder)
        return host::system::systemError(folder.error, path.substr(0, slash));
    return DriveEntry{std::move(*folder), std::move(name), path};
}

SystemResult<struct stat> DriveEntry::status() const
{
    return statusAt(folder, name);
}

std::string DriveEntry::promiseName() const
{
    return PromiseRecord::pathFor(name);
}

SystemResult<DriveEntry::Found> DriveEntry::find() const
{
    const auto own = status();
    if (own)
        return Found{name, *own};
    if (!own.error.is(ENOENT))
        return own.error;
    auto promise = promiseName();
    const auto promised = statusAt(folder, promise);
    if (promised)
        return Found{std::move(promise), *promised};
    // A name that is too long for a promise has none.
    return promised.error.is(ENOENT) || promised.error.is(ENAMETOOLONG) ? own.error : promised.error;
}

SystemError DriveEntry::checkIsFree() const
{
    const auto found = find();
    if (found)
        return {EEXIST, path};
    return found.error.is(ENOENT) ? SystemError() : found.error;
}

Result<LocatedItem> LocatedItem::locate(const DriveLayout& layout, const std::string& path)
{
    auto entry = DriveEntry::open(layout, path);
    if (!entry)
        return *entry.error;
    auto found = entry.value->find();
    if (!found)
        return itemError(found.error, path);
    return LocatedItem{std::move(*entry.value), std::move(found->name), found->status};
}

bool isSameContent(const ItemVersion& a, const ItemVersion& b)
{
    auto renamed = b;
    renamed.changed = a.changed;
    return a == renamed;
}

SystemResult<struct stat> statusAt(const FileDescriptor& folder, const std::string& name)
{
    struct stat found;
    if (::fstatat(folder.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
        return SystemError::last(name);
    return found;
}

SystemError renameEntry(
    const FileDescriptor& from, const std::string& name, const FileDescriptor& to, const std::string& newName)
{
    if (::renameat2(from.get(), name.c_str(), to.get(), newName.c_str(), RENAME_NOREPLACE) == 0)
        return {};
    if (errno != EINVAL)
        return SystemError::last(name);
    // Either the file system does not know the flag, or a folder would come to lie in itself.
    const auto found = statusAt(from, name);
    if (!found)
        return found.error;
    return S_ISDIR(found->st_mode) ? renameFolderByClaim(from, name, to, newName)
                                   : renameByLink(from, name, to, newName);
}

SystemResult<FileDescriptor> openOwnFolder(const std::string& path)
{
    constexpr int flags = O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC;
    FileDescriptor folder(::open(path.c_str(), flags));
    if (!folder && errno == ENOENT) {
        if (::mkdir(path.c_str(), S_IRWXU) != 0 && errno != EEXIST)
            return SystemError::last(path).ofDrive();
        folder = FileDescriptor(::open(path.c_str(), flags));
    }
    if (!folder)
        return SystemError::last(path).ofDrive();
    return folder;
}

bool isReservedName(std::string_view name)
{
    return name.starts_with(host::system::passingPrefix) || PromiseRecord::isPromiseName(name);
}

Error reservedName(const std::string& path)
{
    auto sentence = platform::formatText(
        host::system::translated("The name “%@” can’t be used, because the drive needs it for itself."),
        {host::system::displayName(path)});
    return Error(platform::FileErrorCode::InvalidName,
        {{std::string(platform::errorKey::filePath), path},
            {std::string(platform::errorKey::localizedDescription), std::move(sentence)}});
}

} // namespace host::drive
