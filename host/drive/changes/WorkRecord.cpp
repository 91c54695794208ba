// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/WorkRecord.h"

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>

#include <cerrno>
#include <memory>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

constexpr std::string_view recordSuffix = ".place";
constexpr std::size_t largestRecord = 16 * 1024; // three paths

bool lockWhole(const FileDescriptor& file, int command)
{
    struct flock lock { };
    lock.l_type = F_WRLCK;
    lock.l_whence = SEEK_SET;
    return ::fcntl(file.get(), command, &lock) == 0;
}

std::string textOf(const WorkRecord::Places& places)
{
    // The last NUL shows that the text is whole.
    return places.item + '\0' + places.working + '\0' + places.copy + '\0';
}

/// Answers empty places for a record that was not written whole, because no work had begun then.
WorkRecord::Places placesOf(const std::string& text)
{
    const auto first = text.find('\0'), second = text.find('\0', first + 1);
    if (first == std::string::npos || second == std::string::npos || !text.ends_with('\0')
        || second + 1 == text.size())
        return {};
    return {text.substr(0, first), text.substr(first + 1, second - first - 1),
        text.substr(second + 1, text.size() - second - 2)};
}

} // namespace

WorkRecord::WorkRecord(WorkRecord&& other) noexcept
    : _file(std::move(other._file))
    , _path(std::exchange(other._path, {}))
{
}

WorkRecord::~WorkRecord()
{
    if (!_path.empty())
        ::unlink(_path.c_str());
}

SystemResult<WorkRecord> WorkRecord::write(const DriveLayout& layout, const Places& places)
{
    if (const auto folder = openOwnFolder(layout.held()); !folder)
        return folder.error;
    const auto isFull = [] { return errno == ENOSPC || errno == EDQUOT; };
    const auto text = textOf(places);
    WorkRecord fresh;
    fresh._path = (layout.held() + '/').append(system::lastName(places.working)).append(recordSuffix);
    fresh._file = FileDescriptor(::open(fresh._path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    if (!fresh._file && !isFull())
        return SystemError::last(fresh._path);
    if (fresh._file && !lockWhole(fresh._file, F_OFD_SETLKW))
        return SystemError::last(fresh._path);
    if (fresh._file && ::write(fresh._file.get(), text.data(), text.size()) < 0 && !isFull())
        return SystemError::last(fresh._path);
    return fresh;
}

bool WorkRecord::isRecorded(const DriveLayout& layout, const std::string& name)
{
    struct stat found;
    return name.ends_with(recordSuffix)
        || ::lstat((layout.held() + '/' + name + std::string(recordSuffix)).c_str(), &found) == 0;
}

void WorkRecord::forEachAbandoned(const DriveLayout& layout, const std::function<bool(const Places&)>& settle)
{
    const auto folder = system::openFolder(layout.held());
    if (!folder)
        return;
    const auto reader = std::make_unique<system::DirectoryReader>(*folder);
    while (const auto entry = reader->next()) {
        if (!entry->name.ends_with(recordSuffix))
            continue;
        const auto path = layout.held() + '/' + std::string(entry->name);
        const FileDescriptor file(::open(path.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
        if (!file || !lockWhole(file, F_OFD_SETLK))
            continue; // its process still works
        // A record without text may belong to a living process that has not locked it yet.
        const auto text = readSmallFile(file, path, largestRecord);
        const auto places = text ? placesOf(*text) : Places{};
        if (places.working.empty() ? isProcessGone(std::string(entry->name)) : settle(places))
            ::unlink(path.c_str());
    }
}

} // namespace host::drive
