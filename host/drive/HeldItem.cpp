#include "host/drive/HeldItem.h"

#include "host/drive/SmallFile.h"
#include "host/drive/TreeWalk.h"
#include "host/system/DirectoryReader.h"
#include "platform/Log.h"

#include <fcntl.h>

#include <cerrno>
#include <memory>

namespace host::drive {

using host::system::FileDescriptor;

namespace {

constexpr std::string_view recordSuffix = ".place";
constexpr std::size_t largestRecord = 16 * 1024; // two paths

bool lockWhole(const FileDescriptor& file)
{
    struct flock lock { };
    lock.l_type = F_WRLCK;
    lock.l_whence = SEEK_SET;
    return ::fcntl(file.get(), F_OFD_SETLK, &lock) == 0;
}

bool isOnOneFileSystem(const FileDescriptor& a, const FileDescriptor& b)
{
    struct stat first, second;
    return ::fstat(a.get(), &first) == 0 && ::fstat(b.get(), &second) == 0 && first.st_dev == second.st_dev;
}

/// Puts one item back by its record: where it was and, after a NUL, where it is.
int restore(const DriveLayout& layout, const std::string& record)
{
    const auto end = record.find('\0');
    if (end == std::string::npos)
        return 0; // killed while it was written: nothing had been taken yet
    const auto origin = DriveEntry::open(layout, record.substr(0, end));
    const auto now = record.substr(end + 1);
    struct stat found;
    if (::lstat(now.c_str(), &found) != 0)
        return 0;
    if (!origin)
        return ENOENT;
    const auto name = now.substr(now.rfind('/') + 1);
    if (now == layout.held() + '/' + name)
        return renameEntry(openOwnFolder(layout.held()), name, origin->folder, origin->name);
    const auto beside = DriveEntry::open(layout, now);
    return beside ? renameEntry(beside->folder, name, origin->folder, origin->name) : ENOENT;
}

} // namespace

HeldItem::HeldItem(HeldItem&& other) noexcept
    : _origin(std::move(other._origin))
    , _aside(std::move(other._aside))
    , _record(std::move(other._record))
    , _originName(std::move(other._originName))
    , _name(std::move(other._name))
    , _path(std::move(other._path))
    , _isAside(other._isAside)
    , _recordPath(std::move(other._recordPath))
    , _isThere(std::exchange(other._isThere, false))
{
    other._recordPath.clear();
}

HeldItem::~HeldItem()
{
    if (_isThere)
        putBack();
    forget();
}

int HeldItem::take(const DriveLayout& layout, const DriveEntry& entry, const std::string& name,
    std::optional<HeldItem>& held)
{
    HeldItem item;
    item._aside = openOwnFolder(layout.held());
    item._origin = FileDescriptor(::fcntl(entry.folder.get(), F_DUPFD_CLOEXEC, 0));
    if (!item._aside || !item._origin)
        return errno;
    item._isAside = isOnOneFileSystem(item._aside, item._origin);
    item._originName = name;
    item._path = entry.path;
    item._name = uniqueName(".trwheld-");
    if (const int failure = item.writeRecord(layout); failure != 0)
        return failure;
    if (const int failure = renameEntry(item._origin, name, item.folder(), item._name); failure != 0)
        return failure;
    item._isThere = true;
    held.emplace(std::move(item));
    return 0;
}

int HeldItem::writeRecord(const DriveLayout& layout)
{
    const auto originFolder = _path.substr(0, _path.rfind('/') + 1);
    const auto record =
        originFolder + _originName + '\0' + (_isAside ? layout.held() + '/' : originFolder) + _name;
    _recordPath = layout.held() + '/' + _name + std::string(recordSuffix);
    _record = FileDescriptor(::open(_recordPath.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    if (_record && !lockWhole(_record))
        return errno;
    const auto written = _record ? ::write(_record.get(), record.data(), record.size()) : -1;
    // On a full disk something must be removable still: it is then held without a record.
    if (written >= 0 || errno == ENOSPC || errno == EDQUOT)
        return 0;
    return errno;
}

int HeldItem::remove()
{
    const int failure = removeTree(folder(), _name);
    _isThere = failure != 0;
    if (failure != 0)
        putBack();
    return failure;
}

void HeldItem::putBack()
{
    static constexpr platform::Operation op{"-[HeldItem putBack]"};
    _isThere = false;
    if (const int failure = renameEntry(folder(), _name, _origin, _originName); failure != 0) {
        // Someone saved a new one meanwhile, or the folder is gone: both are kept.
        op.warning("Cannot put back %@, kept as %@: %@", _path, _name, itemError(failure, _path));
        _recordPath.clear();
    }
}

void HeldItem::forget()
{
    if (!_recordPath.empty())
        ::unlink(_recordPath.c_str());
}

void HeldItem::restoreAll(const DriveLayout& layout)
{
    static constexpr platform::Operation op{"+[HeldItem restoreAll]"};
    const auto folder = host::system::openFolder(layout.held());
    if (!folder)
        return;
    const auto reader = std::make_unique<host::system::DirectoryReader>(folder);
    while (const auto entry = reader->next()) {
        if (!entry->name.ends_with(recordSuffix))
            continue;
        const auto path = layout.held() + '/' + std::string(entry->name);
        const FileDescriptor file(::open(path.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
        if (!file || !lockWhole(file))
            continue; // its process still works on it
        const auto record = readSmallFile(file, path, largestRecord);
        const int failure = record ? restore(layout, *record) : 0;
        if (failure == 0)
            ::unlink(path.c_str());
        else
            op.warning("Cannot put back what %@ names: %@", path, itemError(failure, path));
    }
}

} // namespace host::drive
