// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/BeneathRoot.h"

#include <fcntl.h>
#include <linux/openat2.h>
#include <sys/syscall.h>

#include <array>
#include <cerrno>
#include <climits>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

SystemResult<FileDescriptor> openResolved(
    const FileDescriptor& folder, const std::string& path, const open_how& how)
{
    // The kernel answers EAGAIN when something was renamed during the call, and asks for another try.
    for (int tries = 0; tries < 16; ++tries) {
        const auto file = ::syscall(SYS_openat2, folder.get(), path.c_str(), &how, sizeof how);
        if (file >= 0)
            return FileDescriptor(static_cast<int>(file));
        if (errno != EAGAIN && errno != EINTR)
            break;
    }
    return SystemError::last(path);
}

} // namespace

SystemResult<FileDescriptor> openBeneath(const std::string& root, const std::string& relativePath, int flags)
{
    const FileDescriptor folder(::open(root.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!folder)
        return SystemError::last(root);
    open_how how{};
    how.flags = static_cast<std::uint64_t>(flags | O_NOFOLLOW | O_CLOEXEC);
    how.resolve = RESOLVE_BENEATH | RESOLVE_NO_SYMLINKS | RESOLVE_NO_MAGICLINKS;
    return openResolved(folder, relativePath, how);
}

SystemResult<FileDescriptor> openSubfolder(const FileDescriptor& parent, const std::string& name)
{
    open_how how{};
    how.flags = O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC;
    how.resolve = RESOLVE_BENEATH | RESOLVE_NO_SYMLINKS | RESOLVE_NO_XDEV;
    auto folder = openResolved(parent, name, how);
    // EXDEV would look as if the item lay on another file system and had to be copied.
    if (folder.error.is(EXDEV))
        return SystemError(EBUSY, name);
    return folder;
}

std::string descriptorPath(const FileDescriptor& descriptor)
{
    return "/proc/self/fd/" + std::to_string(descriptor.get());
}

std::string pathOf(const FileDescriptor& file)
{
    std::array<char, PATH_MAX> buffer;
    const auto length = ::readlink(descriptorPath(file).c_str(), buffer.data(), buffer.size());
    if (length == static_cast<ssize_t>(buffer.size()))
        errno = ENAMETOOLONG;
    const bool isWhole = length > 0 && length < static_cast<ssize_t>(buffer.size());
    return isWhole ? std::string(buffer.data(), static_cast<std::size_t>(length)) : std::string();
}

} // namespace host::drive
