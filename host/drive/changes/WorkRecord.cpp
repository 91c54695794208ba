// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/WorkRecord.h"

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/files/ItemPaths.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <cerrno>
#include <ctime>
#include <memory>
#include <vector>

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

/// Answers the fields, each ended by a NUL, so that a text that was cut is recognised.
std::string textOf(const WorkRecord::Places& places)
{
    std::string text;
    for (const auto* field :
        {&places.item, &places.working, &places.copy, &places.content, &places.replaced, &places.replacing})
        text.append(*field) += '\0';
    return text;
}

/// Answers empty places for a record that was not written whole, because no work had begun then. Records of
/// older programs have three fields.
WorkRecord::Places placesOf(const std::string& text)
{
    constexpr std::size_t fewestFields = 3, mostFields = 6;
    std::vector<std::string> fields;
    for (std::size_t start = 0; start < text.size();) {
        const auto end = text.find('\0', start);
        if (end == std::string::npos)
            return {};
        fields.push_back(text.substr(start, end - start));
        start = end + 1;
    }
    if (fields.size() < fewestFields || fields.size() > mostFields)
        return {};
    fields.resize(mostFields);
    return {fields[0], fields[1], fields[2], fields[3], fields[4], fields[5]};
}

/// Answers a file without a name, so that a record has its text and is locked when others first see it, or
/// one with the name where the file system has no such files.
FileDescriptor makeFile(const std::string& path, bool& hasName)
{
    FileDescriptor file(::open(system::parentPath(path).c_str(), O_TMPFILE | O_RDWR | O_CLOEXEC, 0600));
    hasName = !file;
    if (!file && (errno == EOPNOTSUPP || errno == EISDIR))
        file = FileDescriptor(::open(path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    return file;
}

bool writeText(const FileDescriptor& file, const std::string& text)
{
    if (::fsetxattr(file.get(), WorkRecord::recordAttribute, text.data(), text.size(), 0) == 0)
        return true;
    // An attribute has room for a path or two; longer texts are written, and synced because nothing else
    // keeps them in order.
    return !system::writeWhole(file, text) && ::fdatasync(file.get()) == 0;
}

bool giveName(const FileDescriptor& file, const std::string& path)
{
    return ::linkat(AT_FDCWD, descriptorPath(file).c_str(), AT_FDCWD, path.c_str(), AT_SYMLINK_FOLLOW) == 0;
}

/// Answers nothing when the text cannot be read, because work may have begun then.
std::optional<std::string> textIn(const FileDescriptor& file, const std::string& path)
{
    auto text = AttributeReader(file).value(WorkRecord::recordAttribute);
    if (!text)
        return std::nullopt;
    return *text ? std::move(*text) : readSmallFile(file, path, largestRecord).value;
}

/// Answers whether a file is so old that whoever made it has locked it, or has ended.
bool isOld(const FileDescriptor& file)
{
    constexpr time_t seconds = 10;
    struct stat found;
    return ::fstat(file.get(), &found) == 0 && found.st_ctim.tv_sec + seconds < ::time(nullptr);
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
    const auto path = (layout.held() + '/').append(system::lastName(places.working)).append(recordSuffix);
    WorkRecord fresh;
    bool hasName = false;
    fresh._file = makeFile(path, hasName);
    if (!fresh._file)
        return isFull() ? SystemResult<WorkRecord>(std::move(fresh)) : SystemError::last(path).ofDrive();
    if (hasName)
        fresh._path = path;
    if (!lockWhole(fresh._file, F_OFD_SETLKW))
        return SystemError::last(path).ofDrive();
    if (!writeText(fresh._file, textOf(places)) && !isFull())
        return SystemError::last(path).ofDrive();
    if (!hasName && !giveName(fresh._file, path) && !isFull())
        return SystemError::last(path).ofDrive();
    fresh._path = path;
    return fresh;
}

std::string WorkRecord::versionText(const platform::ItemVersion& version)
{
    std::string text;
    for (const auto number : {version.inode, version.size, static_cast<std::uint64_t>(version.modified)})
        text += std::to_string(number) + ' ';
    return text;
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
        const auto text = textIn(file, path);
        if (!text)
            continue;
        const auto places = placesOf(*text);
        // A record without text may belong to a living process that has not locked it yet.
        if (places.working.empty() ? isOld(file) : settle(places))
            ::unlink(path.c_str());
    }
}

} // namespace host::drive
