#include "host/drive/TreeWalk.h"

#include "host/drive/DriveEntry.h"
#include "host/system/DirectoryReader.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <array>
#include <cerrno>
#include <memory>
#include <vector>

namespace host::drive {

using host::system::DirectoryReader;
using host::system::FileDescriptor;
using host::system::openFolderAt;

namespace {

// Two descriptors a level, of the usual 1024 for a process.
constexpr int mostLevels = 128;

/// The names in an open folder; answers 0 or the errno. Read whole, because the folder changes meanwhile.
int readNames(const FileDescriptor& folder, std::vector<std::string>& names)
{
    const auto reader = std::make_unique<DirectoryReader>(folder);
    while (const auto entry = reader->next())
        names.emplace_back(entry->name);
    return reader->errorNumber();
}

/// Removes a folder's contents, one level at a time.
class Removal {
public:
    int run(const FileDescriptor& folder, const std::string& name)
    {
        _current = openFolderAt(folder, name);
        int failure = _current ? enter() : errno;
        while (failure == 0 && !_levels.empty())
            failure = _levels.back().subfolders.empty() ? leave() : descend();
        return failure;
    }

private:
    struct Level {
        dev_t device;
        ino_t inode;
        std::vector<std::string> subfolders;
    };

    /// Removes what is no folder from the current one, and notes the others.
    int enter()
    {
        struct stat found;
        std::vector<std::string> names, subfolders;
        if (::fstat(_current.get(), &found) != 0)
            return errno;
        if (const int failure = readNames(_current, names); failure != 0)
            return failure;
        for (auto& name : names) {
            if (::unlinkat(_current.get(), name.c_str(), 0) == 0 || errno == ENOENT)
                continue;
            if (errno != EISDIR)
                return errno;
            subfolders.push_back(std::move(name));
        }
        _levels.push_back({found.st_dev, found.st_ino, std::move(subfolders)});
        return 0;
    }
    int descend()
    {
        auto below = openFolderAt(_current, _levels.back().subfolders.back());
        if (!below)
            return errno;
        _current = std::move(below);
        return enter();
    }
    int leave()
    {
        _levels.pop_back();
        if (_levels.empty())
            return 0;
        auto above = openFolderAt(_current, "..");
        struct stat found;
        // Whoever moved the folder away took its contents along; its new parent is no business of ours.
        if (!above || ::fstat(above.get(), &found) != 0)
            return errno;
        auto& level = _levels.back();
        if (found.st_dev != level.device || found.st_ino != level.inode)
            return ESTALE;
        _current = std::move(above);
        const auto name = std::move(level.subfolders.back());
        level.subfolders.pop_back();
        return ::unlinkat(_current.get(), name.c_str(), AT_REMOVEDIR) == 0 ? 0 : errno;
    }

    FileDescriptor _current;
    std::vector<Level> _levels;
};

int readAttribute(const FileDescriptor& file, const char* name, std::string& value)
{
    value.resize(64 * 1024); // the kernel's own limit
    const auto length = ::fgetxattr(file.get(), name, value.data(), value.size());
    if (length < 0)
        return errno;
    value.resize(static_cast<std::size_t>(length));
    return 0;
}

int copyAttributes(const FileDescriptor& from, const FileDescriptor& to)
{
    std::string names(64 * 1024, '\0'), value;
    const auto length = ::flistxattr(from.get(), names.data(), names.size());
    if (length < 0)
        return errno == EOPNOTSUPP ? 0 : errno;
    for (const char* name = names.data(); name < names.data() + length;
         name += std::char_traits<char>::length(name) + 1) {
        if (!std::string_view(name).starts_with("user."))
            continue;
        if (const int failure = readAttribute(from, name, value); failure != 0)
            return failure;
        if (::fsetxattr(to.get(), name, value.data(), value.size(), 0) != 0)
            return errno;
    }
    return 0;
}

/// Attributes, access and dates, and then to the disk: the last steps of a copy.
int finish(const FileDescriptor& from, const FileDescriptor& to, const struct stat& status)
{
    if (const int failure = copyAttributes(from, to); failure != 0)
        return failure;
    const timespec times[] = {status.st_atim, status.st_mtim};
    const bool isDone = ::fchmod(to.get(), status.st_mode & 07777) == 0 && ::futimens(to.get(), times) == 0
        && ::fsync(to.get()) == 0;
    return isDone ? 0 : errno;
}

using Piece = std::array<char, 64 * 1024>;

ssize_t readPiece(const FileDescriptor& file, Piece& piece)
{
    std::size_t filled = 0;
    while (filled < piece.size()) {
        const auto length = ::read(file.get(), piece.data() + filled, piece.size() - filled);
        if (length < 0 && errno != EINTR)
            return -1;
        if (length == 0)
            break;
        filled += length > 0 ? static_cast<std::size_t>(length) : 0;
    }
    return static_cast<ssize_t>(filled);
}

int writePiece(const FileDescriptor& file, const char* bytes, std::size_t length)
{
    while (length > 0) {
        const auto written = ::write(file.get(), bytes, length);
        if (written < 0 && errno != EINTR)
            return errno;
        const auto done = written > 0 ? static_cast<std::size_t>(written) : 0;
        bytes += done;
        length -= done;
    }
    return 0;
}

int copyContent(const FileDescriptor& from, const FileDescriptor& to)
{
    const auto piece = std::make_unique<Piece>();
    for (;;) {
        const auto length = readPiece(from, *piece);
        if (length <= 0)
            return length < 0 ? errno : 0;
        if (const int failure = writePiece(to, piece->data(), static_cast<std::size_t>(length)); failure != 0)
            return failure;
    }
}

/// 0 when both hold the same bytes; EIO when they do not.
int compareContent(const FileDescriptor& a, const FileDescriptor& b)
{
    if (::lseek(a.get(), 0, SEEK_SET) != 0 || ::lseek(b.get(), 0, SEEK_SET) != 0)
        return errno;
    const auto first = std::make_unique<Piece>(), second = std::make_unique<Piece>();
    for (;;) {
        const auto length = readPiece(a, *first);
        const auto other = readPiece(b, *second);
        if (length < 0 || other < 0)
            return errno;
        if (length != other || !std::equal(first->begin(), first->begin() + length, second->begin()))
            return EIO;
        if (length == 0)
            return 0;
    }
}

int copyFile(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName)
{
    constexpr int common = O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;
    const FileDescriptor from(::openat(folder.get(), name.c_str(), O_RDONLY | common));
    struct stat status;
    if (!from || ::fstat(from.get(), &status) != 0)
        return errno;
    if (!S_ISREG(status.st_mode))
        return EOPNOTSUPP;
    const FileDescriptor to(
        ::openat(target.get(), newName.c_str(), O_RDWR | O_CREAT | O_EXCL | common, S_IRUSR | S_IWUSR));
    if (!to)
        return errno;
    int failure = copyContent(from, to);
    if (failure == 0)
        failure = finish(from, to, status);
    return failure == 0 ? compareContent(from, to) : failure;
}

int copyLink(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName)
{
    std::array<char, 4096> destination{};
    const auto length = ::readlinkat(folder.get(), name.c_str(), destination.data(), destination.size() - 1);
    if (length < 0 || ::symlinkat(destination.data(), target.get(), newName.c_str()) != 0)
        return errno;
    return 0;
}

int copyItem(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level);

int copyFolder(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level)
{
    const auto from = openFolderAt(folder, name);
    struct stat status;
    if (!from || ::fstat(from.get(), &status) != 0)
        return errno;
    if (::mkdirat(target.get(), newName.c_str(), S_IRWXU) != 0)
        return errno;
    const auto to = openFolderAt(target, newName);
    std::vector<std::string> names;
    int failure = to ? readNames(from, names) : errno;
    for (auto each = names.begin(); failure == 0 && each != names.end(); ++each)
        failure = copyItem(from, *each, to, *each, level + 1);
    return failure == 0 ? finish(from, to, status) : failure;
}

int copyItem(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level)
{
    struct stat found;
    if (::fstatat(folder.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
        return errno;
    if (level >= mostLevels)
        return ELOOP;
    if (S_ISDIR(found.st_mode))
        return copyFolder(folder, name, target, newName, level);
    return S_ISLNK(found.st_mode) ? copyLink(folder, name, target, newName)
                                  : copyFile(folder, name, target, newName);
}

int readVersionsBelow(
    const FileDescriptor& parent, const std::string& name, TreeVersions& versions, int level)
{
    struct stat found;
    if (::fstatat(parent.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
        return errno;
    auto version = versionOf(found);
    if (level == 0)
        version.changed = 0;
    versions.emplace(std::pair(version.device, version.inode), version);
    if (!S_ISDIR(found.st_mode))
        return 0;
    if (level >= mostLevels)
        return ELOOP;
    const auto folder = openFolderAt(parent, name);
    std::vector<std::string> names;
    int failure = folder ? readNames(folder, names) : errno;
    for (auto each = names.begin(); failure == 0 && each != names.end(); ++each)
        failure = readVersionsBelow(folder, *each, versions, level + 1);
    return failure;
}

} // namespace

int removeTree(const FileDescriptor& folder, const std::string& name)
{
    if (::unlinkat(folder.get(), name.c_str(), 0) == 0)
        return 0;
    if (errno != EISDIR)
        return errno;
    if (const int failure = Removal().run(folder, name); failure != 0)
        return failure;
    return ::unlinkat(folder.get(), name.c_str(), AT_REMOVEDIR) == 0 ? 0 : errno;
}

int readVersions(const FileDescriptor& folder, const std::string& name, TreeVersions& versions)
{
    return readVersionsBelow(folder, name, versions, 0);
}

int copyTree(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName)
{
    return copyItem(folder, name, target, newName, 0);
}

} // namespace host::drive
