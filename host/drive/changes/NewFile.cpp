// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/NewFile.h"

#include "host/system/files/ItemPaths.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;
using platform::ItemVersion;

NewFile::NewFile(NewFile&& other) noexcept
    : _record(std::move(other._record))
    , _folder(std::move(other._folder))
    , _file(std::move(other._file))
    , _name(std::exchange(other._name, {}))
{
}

NewFile::~NewFile()
{
    if (!_name.empty())
        ::unlinkat(_folder.get(), _name.c_str(), 0);
}

SystemResult<NewFile> NewFile::create(const DriveLayout& layout, const DriveEntry& entry)
{
    NewFile fresh;
    const auto name = uniqueName(WorkRecord::temporaryPrefix);
    auto record = WorkRecord::write(layout, {entry.path, system::siblingPath(entry.path, name), {}});
    if (!record)
        return record.error;
    fresh._record.emplace(std::move(*record));
    fresh._folder = FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0));
    fresh._file = FileDescriptor(
        ::openat(entry.folder.get(), name.c_str(), O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, 0666));
    if (!fresh._folder || !fresh._file)
        return SystemError::last(name);
    fresh._name = name;
    return fresh;
}

SystemError NewFile::write(std::string_view text) const
{
    return system::writeWhole(_file, text);
}

SystemError NewFile::publish(const DriveEntry& entry, const std::string& name)
{
    if (::fsync(_file.get()) != 0)
        return SystemError::last(_name);
    TRW_TRY(renameEntry(_folder, _name, entry.folder, name));
    auto failure = syncFolder(entry.folder);
    // The file is renamed back to its private name and is removed with it.
    if (!failure || renameEntry(entry.folder, name, _folder, _name))
        _name.clear();
    return failure;
}

/// The exchanged file under this name is kept after a kill, because it may hold the save of another program.
SystemError NewFile::takeHeldName(const DriveLayout& layout, const DriveEntry& entry)
{
    auto held = uniqueName(WorkRecord::heldPrefix);
    auto record = WorkRecord::write(layout, {entry.path, system::siblingPath(entry.path, held), {}});
    if (!record)
        return record.error;
    TRW_TRY(renameEntry(_folder, _name, _folder, held));
    _name = std::move(held);
    _record.emplace(std::move(*record));
    return {};
}

SystemError NewFile::exchange(const DriveEntry& entry) const
{
    const int done =
        ::renameat2(_folder.get(), _name.c_str(), entry.folder.get(), entry.name.c_str(), RENAME_EXCHANGE);
    return SystemError::unless(done == 0, entry.name);
}

bool NewFile::isUnderPrivateName() const
{
    struct stat own, found;
    return ::fstat(_file.get(), &own) == 0
        && ::fstatat(_folder.get(), _name.c_str(), &found, AT_SYMLINK_NOFOLLOW) == 0
        && own.st_dev == found.st_dev && own.st_ino == found.st_ino;
}

SystemResult<ItemVersion> NewFile::checkExchanged(const ItemVersion& expected) const
{
    const auto found = statusAt(_folder, _name);
    if (!found)
        return found.error;
    struct stat own;
    if (::fstat(_file.get(), &own) != 0)
        return SystemError::last(_name);
    if (!isSameContent(versionOf(*found), expected))
        return SystemError(ECANCELED, _name);
    return versionOf(own);
}

SystemResult<ItemVersion> NewFile::replace(
    const DriveLayout& layout, const DriveEntry& entry, const ItemVersion& expected)
{
    if (::fsync(_file.get()) != 0)
        return SystemError::last(_name);
    TRW_TRY(takeHeldName(layout, entry));
    TRW_TRY(exchange(entry));
    // The replaced file is checked after the exchange, because only then can no other program replace it.
    auto written = checkExchanged(expected);
    const auto failure = written ? syncFolder(entry.folder) : written.error;
    const bool isKnown = !failure || (!exchange(entry) && isUnderPrivateName());
    // A file that could not be checked or removed is left to the next start.
    if (!isKnown || ::unlinkat(_folder.get(), _name.c_str(), 0) != 0)
        _record->keep();
    _name.clear();
    if (failure)
        return failure;
    return written;
}

} // namespace host::drive
