// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/NewFile.h"

#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/BeneathRoot.h"
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
    if (_name.empty() || ::unlinkat(_folder.get(), _name.c_str(), 0) == 0 || errno != EISDIR)
        return;
    // The next start removes the rest of a folder.
    if (removeTree(_folder, _name))
        _record->keep();
}

/// Answers one that has its record, but nothing under its private name yet.
SystemResult<NewFile> NewFile::begin(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& name, const std::string& content)
{
    NewFile fresh;
    auto record =
        WorkRecord::write(layout, {entry.path, system::siblingPath(entry.path, name), {}, content, {}, {}});
    if (!record)
        return record.error;
    fresh._record.emplace(std::move(*record));
    fresh._folder = FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0));
    if (!fresh._folder)
        return SystemError::last(name);
    return fresh;
}

SystemResult<NewFile> NewFile::create(
    const DriveLayout& layout, const DriveEntry& entry, const std::string& content)
{
    const auto name = uniqueName(WorkRecord::temporaryPrefix);
    auto fresh = begin(layout, entry, name, content);
    if (!fresh)
        return fresh;
    constexpr int flags = O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC;
    fresh->_file = FileDescriptor(::openat(entry.folder.get(), name.c_str(), flags, 0666));
    if (!fresh->_file)
        return SystemError::last(name);
    fresh->_name = name;
    return fresh;
}

SystemResult<NewFile> NewFile::createFolder(const DriveLayout& layout, const DriveEntry& entry)
{
    const auto name = uniqueName(WorkRecord::temporaryPrefix);
    auto fresh = begin(layout, entry, name, {});
    if (!fresh)
        return fresh;
    if (::mkdirat(entry.folder.get(), name.c_str(), S_IRWXU) != 0)
        return SystemError::last(name);
    fresh->_name = name;
    auto opened = openSubfolder(entry.folder, name);
    if (!opened)
        return opened.error;
    fresh->_file = std::move(*opened);
    return fresh;
}

SystemError NewFile::write(std::string_view text) const
{
    return system::writeWhole(_file, text);
}

SystemResult<std::uint64_t> NewFile::bytes() const
{
    struct stat own;
    if (::fstat(_file.get(), &own) != 0)
        return SystemError::last(_name);
    return S_ISDIR(own.st_mode) ? checkCopyable(_folder, _name)
                                : SystemResult<std::uint64_t>(static_cast<std::uint64_t>(own.st_size));
}

SystemError NewFile::publish(const DriveEntry& entry, const std::string& name, Sync sync)
{
    if (sync != Sync::Nothing && ::fsync(_file.get()) != 0)
        return SystemError::last(_name);
    TRW_TRY(renameEntry(_folder, _name, entry.folder, name));
    auto failure = sync == Sync::ContentAndName ? syncFolder(entry.folder) : SystemError();
    // The file is renamed back to its private name and is removed with it.
    if (!failure || renameEntry(entry.folder, name, _folder, _name))
        _name.clear();
    return failure;
}

/// The exchanged file under this name is kept after a kill, because it may hold the save of another program.
SystemError NewFile::takeHeldName(
    const DriveLayout& layout, const DriveEntry& entry, const ItemVersion& expected)
{
    auto held = uniqueName(WorkRecord::heldPrefix);
    struct stat own;
    if (::fstat(_file.get(), &own) != 0)
        return SystemError::last(_name);
    auto record = WorkRecord::write(layout,
        {entry.path, system::siblingPath(entry.path, held), {}, {}, WorkRecord::versionText(expected),
            WorkRecord::versionText(versionOf(own))});
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
    // A file system that cannot exchange two names answers EINVAL, which elsewhere means a bad name.
    return done != 0 && errno == EINVAL ? SystemError(EOPNOTSUPP, entry.name)
                                        : SystemError::unless(done == 0, entry.name);
}

bool NewFile::isUnderPrivateName() const
{
    struct stat own;
    const auto found = statusAt(_folder, _name);
    return found && ::fstat(_file.get(), &own) == 0 && isSameFile(own, *found);
}

/// Answers this file's version when the replaced file is the expected one, else ECANCELED.
SystemResult<ItemVersion> NewFile::finishExchange(
    const DriveEntry& entry, const ItemVersion& expected, const ItemTraits& traits) const
{
    // The replaced file is checked after the exchange, because only then can no other program replace it.
    const auto found = statusAt(_folder, _name);
    if (!found)
        return found.error;
    if (!isSameContent(versionOf(*found), expected))
        return SystemError(ECANCELED, _name);
    TRW_TRY(adoptChanges(traits));
    TRW_TRY(syncFolder(entry.folder));
    struct stat own;
    if (::fstat(_file.get(), &own) != 0)
        return SystemError::last(_name);
    return versionOf(own);
}

/// Gives this file the tags, the identifier and the access that the replaced one got since it was read.
SystemError NewFile::adoptChanges(const ItemTraits& traits) const
{
    const FileDescriptor replaced(
        ::openat(_folder.get(), _name.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    const auto now = replaced ? ItemTraits::read(replaced) : SystemError::last(_name);
    return now ? now->writeChanges(traits, _file) : now.error;
}

/// Exchanges the names until what comes out is what was put there last. Then nobody has saved in between, and
/// the newest version has the name.
void NewFile::exchangeBack(const DriveEntry& entry) const
{
    constexpr int mostExchanges = 64;
    const auto openPrivate = [&] {
        return FileDescriptor(::openat(_folder.get(), _name.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
    };
    // Each file stays open while it is compared, because a new file could get the inode of a removed one.
    FileDescriptor lastPut(::fcntl(_file.get(), F_DUPFD_CLOEXEC, 0));
    for (int exchanges = 0; exchanges < mostExchanges; ++exchanges) {
        auto put = openPrivate();
        if (const auto failure = exchange(entry)) {
            // Another program removed the document, so the name is free for the version that it has not seen.
            if (failure.is(ENOENT))
                static_cast<void>(renameEntry(_folder, _name, entry.folder, entry.name));
            return;
        }
        const auto out = openPrivate();
        struct stat last, came;
        const bool isKnown = ::fstat(lastPut.get(), &last) == 0 && ::fstat(out.get(), &came) == 0;
        if (!isKnown || isSameFile(last, came))
            return;
        lastPut = std::move(put);
    }
}

SystemResult<ItemVersion> NewFile::replace(
    const DriveLayout& layout, const DriveEntry& entry, const ItemVersion& expected, const ItemTraits& traits)
{
    if (::fsync(_file.get()) != 0)
        return SystemError::last(_name);
    TRW_TRY(takeHeldName(layout, entry, expected));
    TRW_TRY(exchange(entry));
    const auto written = finishExchange(entry, expected, traits);
    if (!written)
        exchangeBack(entry);
    const bool isKnown = written || isUnderPrivateName();
    // A file that could not be checked or removed is left to the next start.
    if (!isKnown || ::unlinkat(_folder.get(), _name.c_str(), 0) != 0)
        _record->keep();
    _name.clear();
    return written;
}

} // namespace host::drive
