// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/DeepEnumeration.h"

#include "host/system/files/DirectoryReader.h"
#include "host/system/files/SystemErrors.h"

#include <sys/stat.h>

#include <algorithm>
#include <cerrno>

namespace host::system {

using platform::FileType;
using platform::PathKind;
using platform::Url;

namespace {

// This is far below the usual limit of 1024 descriptors for a process, and deeper than folders usually are.
constexpr std::size_t openLevels = 64;

} // namespace

void DeepEnumeration::run()
{
    auto descriptor = openFolder(_root.path());
    auto next =
        descriptor ? enter(std::move(*descriptor), _root.path()) : fail(_root.path(), descriptor.error);
    while (next == Continue::Yes && !_levels.empty())
        next = _levels.back().subfolders.empty() ? leave() : descend();
}

DeepEnumeration::Continue DeepEnumeration::fail(const std::string& path, const SystemError& failure)
{
    return _error(Url::fileURL(path, PathKind::Directory), systemError(failure, path));
}

DeepEnumeration::Continue DeepEnumeration::enter(FileDescriptor descriptor, std::string path)
{
    struct stat found;
    if (::fstat(descriptor.get(), &found) != 0)
        return fail(path, SystemError::last());
    _levels.push_back({std::move(path), std::move(descriptor), found.st_dev, found.st_ino, {}});
    if (_levels.size() > openLevels)
        _levels[_levels.size() - openLevels - 1].descriptor.reset();
    return readEntries(_levels.back());
}

DeepEnumeration::Continue DeepEnumeration::readEntries(Level& level)
{
    DirectoryReader reader(level.descriptor);
    while (const auto entry = reader.next()) {
        const auto type = reader.typeOf(*entry);
        if (!type)
            continue; // it was removed since the folder was read
        if (*type == FileType::Directory)
            level.subfolders.emplace_back(entry->name);
        if (report(level, entry->name, *type) == Continue::No)
            return Continue::No;
    }
    std::ranges::reverse(level.subfolders);
    return reader.error() ? fail(level.path, reader.error()) : Continue::Yes;
}

DeepEnumeration::Continue DeepEnumeration::report(const Level& level, std::string_view name, FileType type)
{
    const auto kind = type == FileType::Directory ? PathKind::Directory : PathKind::Unknown;
    return _entry(Url::fileURL(level.path + '/' + std::string(name), kind), type);
}

DeepEnumeration::Continue DeepEnumeration::descend()
{
    auto& level = _levels.back();
    const auto name = std::move(level.subfolders.back());
    level.subfolders.pop_back();
    auto path = level.path + '/' + name;
    auto descriptor = openFolderAt(level.descriptor, name);
    return descriptor ? enter(std::move(*descriptor), std::move(path)) : fail(path, descriptor.error);
}

DeepEnumeration::Continue DeepEnumeration::leave()
{
    const auto below = std::move(_levels.back());
    _levels.pop_back();
    if (_levels.empty() || _levels.back().descriptor)
        return Continue::Yes;
    auto& level = _levels.back();
    level.descriptor = openFolderAt(below.descriptor, "..").value.value_or(FileDescriptor());
    // When another program moved the folder below meanwhile, ".." now leads to another folder.
    if (!isAt(level))
        level.descriptor = openFolder(level.path).value.value_or(FileDescriptor());
    if (isAt(level))
        return Continue::Yes;
    level.descriptor.reset();
    const bool isLost = !level.subfolders.empty();
    level.subfolders.clear();
    return isLost ? fail(level.path, SystemError(ESTALE)) : Continue::Yes;
}

bool DeepEnumeration::isAt(const Level& level)
{
    struct stat found;
    return ::fstat(level.descriptor.get(), &found) == 0 && found.st_dev == level.device
        && found.st_ino == level.inode;
}

} // namespace host::system
