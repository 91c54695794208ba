// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/trash/TrashPlace.h"

#include "host/drive/changes/TreeWalk.h"
#include "host/drive/changes/WorkRecord.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"

#include <fcntl.h>

#include <algorithm>
#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

SystemResult<LocatedItem> locateIn(
    const FileDescriptor& folder, const std::string& folderPath, const std::string& nameOnDisk)
{
    const auto found = statusAt(folder, nameOnDisk);
    if (!found)
        return found.error;
    // Something may have the name of a promise and be none.
    const auto promised = system::promisedName(folder, nameOnDisk);
    auto name = promised ? *promised : nameOnDisk;
    FileDescriptor own(::fcntl(folder.get(), F_DUPFD_CLOEXEC, 0));
    if (!own)
        return SystemError::last(nameOnDisk);
    const auto path = folderPath + '/' + name;
    return LocatedItem{{std::move(own), std::move(name), path}, nameOnDisk, *found};
}

SystemResult<TrashPlace> TrashPlace::make(
    const FileDescriptor& trash, const std::string& trashPath, const TrashRecord& record)
{
    const auto name = uniqueName(prefix);
    if (::mkdirat(trash.get(), name.c_str(), S_IRWXU) != 0)
        return SystemError::last(name);
    auto place = open(trash, trashPath, name);
    auto failure = place ? place->write(record) : place.error;
    // The folder must be on the disk before the item is in it.
    if (!failure)
        failure = syncFolder(trash);
    if (!failure)
        return place;
    if (place)
        place->dropIfEmpty(trash);
    else
        ::unlinkat(trash.get(), name.c_str(), AT_REMOVEDIR);
    return failure;
}

SystemResult<TrashPlace> TrashPlace::open(
    const FileDescriptor& trash, const std::string& trashPath, const std::string& name)
{
    auto folder = system::openFolderAt(trash, name);
    if (!folder)
        return folder.error;
    TrashPlace place;
    place._folder = std::move(*folder);
    place._path = trashPath + '/' + name;
    place._name = name;
    return place;
}

SystemResult<std::optional<TrashRecord>> TrashPlace::record() const
{
    const auto text = system::readWholeFile(_folder, TrashRecord::fileName, TrashRecord::maximumFileSize);
    if (!text && !text.error.is(ENOENT) && !text.error.is(EFBIG))
        return text.error;
    return text ? TrashRecord::parse(*text) : std::nullopt;
}

SystemError TrashPlace::write(const TrashRecord& record) const
{
    return system::writeFileAtomically(_folder, TrashRecord::fileName, record.text());
}

DriveEntry TrashPlace::entry(const std::string& itemName) const
{
    return {FileDescriptor(::fcntl(_folder.get(), F_DUPFD_CLOEXEC, 0)), itemName, _path + '/' + itemName};
}

SystemResult<LocatedItem> TrashPlace::item() const
{
    // The folder is opened again, because reading moves the position of a descriptor.
    const auto folder = system::openFolderAt(_folder, ".");
    if (!folder)
        return folder.error;
    const auto names = readNames(*folder);
    if (!names)
        return names.error;
    const auto name = std::ranges::find_if_not(*names, system::isPassingName);
    return name == names->end() ? SystemError(ENOENT, _name) : locateIn(_folder, _path, *name);
}

void TrashPlace::dropIfEmpty(const FileDescriptor& trash) const
{
    const auto folder = system::openFolderAt(_folder, ".");
    const auto names = folder ? readNames(*folder) : folder.error;
    const auto mayGo = [](const std::string& name) {
        return name == TrashRecord::fileName || name.starts_with(WorkRecord::temporaryPrefix);
    };
    if (!names || !std::ranges::all_of(*names, mayGo))
        return;
    // A folder is a copy that is not whole, which Recovery removes.
    for (const auto& name : *names) {
        if (name != TrashRecord::fileName && ::unlinkat(_folder.get(), name.c_str(), 0) != 0)
            return;
    }
    ::unlinkat(_folder.get(), TrashRecord::fileName, 0);
    ::unlinkat(trash.get(), _name.c_str(), AT_REMOVEDIR);
}

} // namespace host::drive
