// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/PosixFileSystem.h"

#include "host/system/files/DeepEnumeration.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/FileVersion.h"
#include "host/system/files/SystemErrors.h"

#include <fcntl.h>
#include <glib.h>
#include <sys/stat.h>
#include <sys/xattr.h>

#include <cerrno>
#include <climits>

namespace host::system {

using platform::FileAttributes;
using platform::FileType;

namespace {

bool isExtensionHidden(const std::string& path)
{
    char value[2];
    return lgetxattr(path.c_str(), hiddenExtensionAttribute, value, sizeof value) == 1 && value[0] == '1';
}

/// Answers whether a path contains a NUL, because the system would take the part before it for the whole
/// path.
bool holdsNul(const std::string& path)
{
    return path.find('\0') != std::string::npos;
}

} // namespace

platform::Result<FileAttributes> PosixFileSystem::attributesOfItem(const std::string& path) const
{
    if (holdsNul(path))
        return systemError(EILSEQ, path);
    struct statx found;
    constexpr int flags = AT_SYMLINK_NOFOLLOW | AT_NO_AUTOMOUNT;
    if (statx(AT_FDCWD, path.c_str(), flags, STATX_BASIC_STATS | STATX_BTIME, &found) != 0)
        return systemError(errno, path);
    FileAttributes attributes;
    attributes.type = fileType(found.stx_mode);
    attributes.size = found.stx_size;
    if (found.stx_mask & STATX_BTIME)
        attributes.creationDate = dateOf(found.stx_btime);
    attributes.modificationDate = dateOf(found.stx_mtime);
    attributes.extensionHidden = isExtensionHidden(path);
    return attributes;
}

platform::Result<std::string> PosixFileSystem::destinationOfSymbolicLink(const std::string& path) const
{
    if (holdsNul(path))
        return systemError(EILSEQ, path);
    std::string destination(PATH_MAX, '\0');
    const auto length = ::readlink(path.c_str(), destination.data(), destination.size());
    if (length < 0)
        return systemError(errno, path);
    destination.resize(static_cast<std::size_t>(length));
    return destination;
}

std::optional<FileType> PosixFileSystem::typeOfItem(const std::string& path) const
{
    struct stat found;
    if (holdsNul(path) || ::stat(path.c_str(), &found) != 0)
        return std::nullopt;
    return fileType(found.st_mode);
}

std::optional<platform::Url> PosixFileSystem::userDocumentsFolder() const
{
    const char* path = g_get_user_special_dir(G_USER_DIRECTORY_DOCUMENTS);
    // For a user without such a folder the system answers the home folder in its place.
    if (!path || std::string_view(path) == g_get_home_dir())
        return std::nullopt;
    return platform::Url::fileURL(path, platform::PathKind::Directory);
}

void PosixFileSystem::enumerateDeeply(const platform::Url& folder,
    const std::function<Continue(const platform::Url&, FileType)>& entry,
    const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const
{
    DeepEnumeration(folder, entry, error).run();
}

void PosixFileSystem::enumerateShallowly(const platform::Url& folder,
    const std::function<Continue(const platform::Url&, FileType)>& entry,
    const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const
{
    const auto descriptor = openFolder(folder.path());
    if (!descriptor) {
        error(folder, systemError(descriptor.error, folder.path()));
        return;
    }
    DirectoryReader reader(*descriptor);
    while (const auto found = reader.next()) {
        const auto type = reader.typeOf(*found);
        const auto kind =
            type == FileType::Directory ? platform::PathKind::Directory : platform::PathKind::Unknown;
        if (type && entry(folder.appendingPathComponent(found->name, kind), *type) == Continue::No)
            return;
    }
    if (reader.error())
        error(folder, systemError(reader.error(), folder.path()));
}

} // namespace host::system
