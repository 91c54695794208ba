// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/DriveEntry.h"

#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/SystemErrors.h"

#include <fcntl.h>
#include <signal.h>

#include <cerrno>
#include <charconv>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::ItemVersion;
using platform::Result;

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
    if (const auto promised = statusAt(folder, promise))
        return Found{std::move(promise), *promised};
    return own.error;
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
    const int done = ::renameat2(from.get(), name.c_str(), to.get(), newName.c_str(), RENAME_NOREPLACE);
    return SystemError::unless(done == 0, name);
}

SystemResult<FileDescriptor> openOwnFolder(const std::string& path)
{
    if (::mkdir(path.c_str(), S_IRWXU) != 0 && errno != EEXIST)
        return SystemError::last(path);
    FileDescriptor folder(::open(path.c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!folder)
        return SystemError::last(path);
    return folder;
}

bool isProcessGone(const std::string& uniqueName)
{
    int process = 0;
    const char* begin = uniqueName.data() + uniqueName.find('-') + 1;
    std::from_chars(begin, uniqueName.data() + uniqueName.size(), process, 16);
    return process > 0 && ::kill(process, 0) != 0 && errno == ESRCH;
}

} // namespace host::drive
