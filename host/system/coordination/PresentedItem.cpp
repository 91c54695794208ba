// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/PresentedItem.h"

#include "host/system/files/FileVersion.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"

#include <fcntl.h>

#include <array>
#include <cerrno>
#include <climits>

namespace host::system {

namespace {

FileDescriptor openAsMark(const std::string& path)
{
    return FileDescriptor(::open(path.c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC));
}

} // namespace

PresentedItem::Finding PresentedItem::look()
{
    auto found = openAsMark(_path);
    if (!found && errno == ENOENT)
        found = openAsMark(promisePath(_path));
    struct stat status;
    if (!found) {
        if (!_file || (errno != ENOENT && errno != ENOTDIR))
            return Finding::Same;
        const auto place = whereabouts();
        return place ? Finding::Moved : place.error.is(ENOENT) ? Finding::Gone : Finding::Same;
    }
    if (::fstat(found.get(), &status) != 0)
        return Finding::Same;
    const auto version = versionOf(status);
    const bool isSame = _file && version == _version;
    _file = std::move(found);
    _version = version;
    _isFolder = S_ISDIR(status.st_mode);
    return isSame ? Finding::Same : Finding::Changed;
}

SystemResult<std::string> PresentedItem::whereabouts() const
{
    std::array<char, PATH_MAX> buffer;
    const auto link = "/proc/self/fd/" + std::to_string(_file.get());
    const auto length = ::readlink(link.c_str(), buffer.data(), buffer.size());
    if (length < 0)
        return SystemError::last(_path);
    const std::string path(buffer.data(), static_cast<std::size_t>(length));
    // The kernel names a removed file too, with a remark at the end that could be part of a name, so the file
    // is checked.
    struct stat status;
    if (::lstat(path.c_str(), &status) != 0)
        return errno == ENOTDIR ? SystemError(ENOENT, path) : SystemError::last(path);
    auto promised = promisedName(path);
    if (!promised && !promised.error.is(EBADMSG))
        return promised.error;
    const auto name = promised ? std::move(*promised) : std::string(lastName(path));
    if (isPassingName(name) || isLongPromiseName(name) || status.st_dev != _version.device
        || status.st_ino != _version.inode)
        return SystemError(ENOENT, path);
    return siblingPath(path, name);
}

void PresentedItem::forget()
{
    _file.reset();
    _isFolder = false;
}

} // namespace host::system
