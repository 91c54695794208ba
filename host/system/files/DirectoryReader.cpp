// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/DirectoryReader.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <string>

namespace host::system {

using platform::FileType;

namespace {

constexpr int openFlags = O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC;

std::optional<FileType> typeSaidBy(const dirent64& entry)
{
    if (entry.d_type == DT_UNKNOWN)
        return std::nullopt;
    return fileType(static_cast<unsigned>(DTTOIF(entry.d_type)));
}

} // namespace

bool DirectoryReader::fill()
{
    const auto read = getdents64(_folder.get(), _buffer.data(), _buffer.size());
    _error = SystemError::unless(read >= 0);
    _position = 0;
    _end = read > 0 ? static_cast<std::size_t>(read) : 0;
    return _end > 0;
}

std::optional<DirectoryReader::Entry> DirectoryReader::next()
{
    while (_position < _end || fill()) {
        const auto& entry = *reinterpret_cast<const dirent64*>(_buffer.data() + _position);
        _position += entry.d_reclen;
        const std::string_view name(entry.d_name);
        if (name != "." && name != "..")
            return Entry{name, typeSaidBy(entry)};
    }
    return std::nullopt;
}

FileType fileType(unsigned mode)
{
    if (S_ISREG(mode))
        return FileType::Regular;
    if (S_ISDIR(mode))
        return FileType::Directory;
    return S_ISLNK(mode) ? FileType::SymbolicLink : FileType::Other;
}

std::optional<FileType> DirectoryReader::typeOf(const Entry& entry) const
{
    if (entry.type)
        return entry.type;
    const auto type = typeOfEntry(_folder, entry.name);
    return type.error.is(ENOENT) ? std::nullopt : std::optional(type.value.value_or(FileType::Other));
}

SystemResult<FileType> typeOfEntry(const FileDescriptor& folder, std::string_view name)
{
    struct statx attributes;
    const std::string terminated(name);
    if (statx(
            folder.get(), terminated.c_str(), AT_SYMLINK_NOFOLLOW | AT_NO_AUTOMOUNT, STATX_TYPE, &attributes)
        != 0)
        return SystemError::last(name);
    return fileType(attributes.stx_mode);
}

SystemResult<FileDescriptor> openFolder(const std::string& path)
{
    FileDescriptor folder(::open(path.c_str(), openFlags));
    if (!folder)
        return SystemError::last(path);
    return folder;
}

SystemResult<FileDescriptor> openFolderAt(const FileDescriptor& parent, const std::string& name)
{
    FileDescriptor folder(::openat(parent.get(), name.c_str(), openFlags));
    if (!folder)
        return SystemError::last(name);
    return folder;
}

} // namespace host::system
