// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/TreeCopy.h"

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/drive/records/ItemMarks.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/DriveNames.h"

#include <fcntl.h>
#include <sys/xattr.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <memory>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

// Each level takes two descriptors, of the usual 1024 for a process.
constexpr int mostLevels = 128;
constexpr int openFlags = O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;

FileDescriptor openForReading(const FileDescriptor& folder, const std::string& name)
{
    return FileDescriptor(::openat(folder.get(), name.c_str(), O_RDONLY | openFlags));
}

/// Copies the attributes that make a file a promise; ItemTraits leaves these out.
SystemError copyPromise(const FileDescriptor& from, const FileDescriptor& to)
{
    const AttributeReader attributes(from);
    for (const char* name : {itemMark::promise, itemMark::type, system::promisedNameAttribute}) {
        const auto value = attributes.value(name);
        if (!value)
            return value.error;
        const auto& text = *value;
        if (text && ::fsetxattr(to.get(), name, text->data(), text->size(), 0) != 0)
            return SystemError::last(name);
    }
    return {};
}

/// Finishes a copy: copies traits and dates, and syncs the file.
SystemError finish(const FileDescriptor& from, const FileDescriptor& to, const struct stat& status)
{
    const auto traits = ItemTraits::read(from);
    if (!traits)
        return traits.error;
    TRW_TRY(traits->write(to));
    TRW_TRY(copyPromise(from, to));
    const timespec times[] = {status.st_atim, status.st_mtim};
    return SystemError::unless(::futimens(to.get(), times) == 0 && ::fsync(to.get()) == 0);
}

/// Answers whether two files hold the same promise, or none; not when that cannot be read.
bool isSamePromise(const FileDescriptor& a, const FileDescriptor& b)
{
    const auto first = AttributeReader(a).value(itemMark::promise);
    const auto second = AttributeReader(b).value(itemMark::promise);
    return first && second && *first == *second;
}

/// Answers the access of a copy: that of its original, but no more than others have to what the user makes,
/// and the user's own always.
mode_t rightsOfNew(mode_t original, mode_t fresh)
{
    constexpr mode_t mayRead = S_IRUSR | S_IRGRP | S_IROTH, all = S_IRWXU | S_IRWXG | S_IRWXO;
    if (S_ISDIR(original))
        return (original & fresh & all) | S_IRWXU;
    const auto rights = (original & fresh & all) | S_IRUSR | S_IWUSR;
    return (original & S_IXUSR) != 0 ? rights | ((rights & mayRead) >> 2) : rights;
}

/// Finishes a copy that is an item of its own. The drive's attributes belong to the original.
SystemError finishAsNew(const FileDescriptor& from, const FileDescriptor& to, const struct stat& status)
{
    struct stat fresh;
    if (::fstat(to.get(), &fresh) != 0)
        return SystemError::last();
    auto traits = ItemTraits::read(from);
    if (!traits)
        return traits.error;
    std::erase_if(traits->attributes, [](const auto& attribute) {
        const std::string_view name = attribute.first;
        return !name.starts_with("user.") || name.starts_with("user.tarrow.")
            || name.starts_with("user.trw.");
    });
    traits->owner = fresh.st_uid;
    traits->group = fresh.st_gid;
    traits->mode = rightsOfNew(status.st_mode, fresh.st_mode);
    TRW_TRY(traits->write(to));
    const timespec times[] = {status.st_atim, status.st_mtim};
    if (::futimens(to.get(), times) != 0 || ::fsync(to.get()) != 0)
        return SystemError::last();
    struct stat now;
    if (::fstat(from.get(), &now) != 0)
        return SystemError::last();
    return versionOf(now) == versionOf(status) ? SystemError() : SystemError(ECANCELED);
}

using Piece = std::array<char, 64 * 1024>;

SystemResult<std::size_t> readPiece(const FileDescriptor& file, Piece& piece)
{
    std::size_t filled = 0;
    while (filled < piece.size()) {
        const auto length = ::read(file.get(), piece.data() + filled, piece.size() - filled);
        if (length < 0 && errno != EINTR)
            return SystemError::last();
        if (length == 0)
            break;
        filled += length > 0 ? static_cast<std::size_t>(length) : 0;
    }
    return filled;
}

/// A copy that is under way.
struct Copying {
    const CopyProgress& copied;
    bool isNew = false; ///< it is an item of its own
    std::uint64_t done = 0; ///< bytes of whole files

    SystemError tell(std::uint64_t ofThisFile) const
    {
        return copied ? copied(done + ofThisFile) : SystemError();
    }
    /// Answers the access of what is made; what gets the access of its original is private until then.
    mode_t rights(mode_t ofNew) const { return isNew ? ofNew : ofNew & S_IRWXU; }
};

SystemError copyContent(const FileDescriptor& from, const FileDescriptor& to, Copying& copying)
{
    std::uint64_t bytes = 0;
    TRW_TRY(copyBytes(from, to, [&](std::uint64_t ofThisFile) {
        bytes = ofThisFile;
        return copying.tell(bytes);
    }));
    copying.done += bytes;
    return {};
}

SystemError copyFile(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, Copying& copying)
{
    const auto from = openForReading(folder, name);
    struct stat status;
    if (!from || ::fstat(from.get(), &status) != 0)
        return SystemError::last(name);
    if (!S_ISREG(status.st_mode))
        return {EOPNOTSUPP, name};
    const FileDescriptor to(
        ::openat(target.get(), newName.c_str(), O_RDWR | O_CREAT | O_EXCL | openFlags, copying.rights(0666)));
    if (!to)
        return SystemError::last(newName);
    TRW_TRY(copyContent(from, to, copying));
    if (copying.isNew)
        return finishAsNew(from, to, status);
    TRW_TRY(finish(from, to, status));
    return compareBytes(from, to);
}

SystemError copyItem(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level, Copying& copying);

SystemError copyAll(const FileDescriptor& from, const FileDescriptor& to, int level, Copying& copying)
{
    const auto names = readNames(from);
    if (!names)
        return names.error;
    for (const auto& each : *names)
        TRW_TRY(copyItem(from, each, to, each, level, copying));
    return {};
}

SystemError copyFolder(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level, Copying& copying)
{
    const auto from = openSubfolder(folder, name);
    if (!from)
        return from.error;
    struct stat status;
    if (::fstat(from->get(), &status) != 0)
        return SystemError::last(name);
    if (::mkdirat(target.get(), newName.c_str(), copying.rights(0777)) != 0)
        return SystemError::last(newName);
    const auto to = openSubfolder(target, newName);
    if (!to)
        return to.error;
    TRW_TRY(copyAll(*from, *to, level + 1, copying));
    return copying.isNew ? finishAsNew(*from, *to, status) : finish(*from, *to, status);
}

SystemError copyItem(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName, int level, Copying& copying)
{
    const auto found = statusAt(folder, name);
    if (!found)
        return found.error;
    if (level >= mostLevels)
        return {ELOOP, name};
    if (copying.isNew && isReservedName(name))
        return {ECANCELED, name};
    TRW_TRY(copying.tell(0));
    if (S_ISDIR(found->st_mode))
        return copyFolder(folder, name, target, newName, level, copying);
    return S_ISLNK(found->st_mode) ? copyLink(folder, name, target, newName)
                                   : copyFile(folder, name, target, newName, copying);
}

class CopyableCheck : public TreeVisitor {
public:
    std::uint64_t bytes = 0;

    SystemError visitItem(
        const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        if (!S_ISREG(found.st_mode))
            return S_ISLNK(found.st_mode) ? SystemError() : SystemError(EOPNOTSUPP, name);
        bytes += static_cast<std::uint64_t>(found.st_size);
        return SystemError::unless(::faccessat(folder.get(), name.c_str(), R_OK, AT_EACCESS) == 0, name);
    }
    SystemError enterFolder(
        const FileDescriptor&, const struct stat&, const std::vector<std::string>&) override
    {
        return ++_levels < mostLevels ? SystemError() : SystemError(ELOOP);
    }
    SystemError leaveFolder(const FileDescriptor&, const std::string&) override
    {
        --_levels;
        return {};
    }

private:
    int _levels = 0;
};

/// The two names, in two open folders, that are compared.
struct Pair {
    const FileDescriptor& folder;
    const std::string& name;
    const FileDescriptor& otherFolder;
    const std::string& otherName;
};

std::optional<std::vector<std::string>> sortedNames(const FileDescriptor& folder)
{
    auto names = readNames(folder);
    if (names)
        std::ranges::sort(*names);
    return std::move(names.value);
}

bool isSameItem(const Pair& pair, int level);

bool holdSame(const FileDescriptor& a, const FileDescriptor& b, int level)
{
    const auto names = sortedNames(a), others = names ? sortedNames(b) : std::nullopt;
    return others && *names == *others && std::ranges::all_of(*names, [&](const std::string& name) {
        return isSameItem({a, name, b, name}, level);
    });
}

bool isSameFolder(const Pair& pair, int level)
{
    const auto a = openSubfolder(pair.folder, pair.name), b = openSubfolder(pair.otherFolder, pair.otherName);
    return a && b && level < mostLevels && holdSame(*a, *b, level + 1);
}

bool isSameLink(const Pair& pair)
{
    std::array<char, 4096> a{}, b{};
    const auto length = ::readlinkat(pair.folder.get(), pair.name.c_str(), a.data(), a.size());
    return length >= 0
        && ::readlinkat(pair.otherFolder.get(), pair.otherName.c_str(), b.data(), b.size()) == length
        && a == b;
}

bool isSameItem(const Pair& pair, int level)
{
    const auto found = statusAt(pair.folder, pair.name);
    const auto other = found ? statusAt(pair.otherFolder, pair.otherName) : found.error;
    if (!found || !other || (found->st_mode & S_IFMT) != (other->st_mode & S_IFMT))
        return false;
    if (S_ISDIR(found->st_mode))
        return isSameFolder(pair, level);
    if (S_ISLNK(found->st_mode))
        return isSameLink(pair);
    const auto a = openForReading(pair.folder, pair.name),
               b = openForReading(pair.otherFolder, pair.otherName);
    return S_ISREG(found->st_mode) && a && b && isSamePromise(a, b) && !compareBytes(a, b);
}

} // namespace

SystemError copyBytes(const FileDescriptor& from, const FileDescriptor& to, const CopyProgress& copied)
{
    const auto piece = std::make_unique<Piece>();
    std::uint64_t done = 0;
    for (;;) {
        const auto length = readPiece(from, *piece);
        if (!length || *length == 0)
            return length.error;
        TRW_TRY(system::writeWhole(to, {piece->data(), *length}));
        done += *length;
        if (copied)
            TRW_TRY(copied(done));
    }
}

SystemError compareBytes(const FileDescriptor& a, const FileDescriptor& b)
{
    if (::lseek(a.get(), 0, SEEK_SET) != 0 || ::lseek(b.get(), 0, SEEK_SET) != 0)
        return SystemError::last();
    const auto first = std::make_unique<Piece>(), second = std::make_unique<Piece>();
    for (;;) {
        const auto length = readPiece(a, *first);
        const auto other = readPiece(b, *second);
        if (!length || !other)
            return length ? other.error : length.error;
        if (*length != *other || std::memcmp(first->data(), second->data(), *length) != 0)
            return SystemError(EIO);
        if (*length == 0)
            return {};
    }
}

SystemError copyTree(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName)
{
    const CopyProgress untold;
    Copying copying{untold};
    return copyItem(folder, name, target, newName, 0, copying);
}

SystemError copyContents(
    const FileDescriptor& folder, const FileDescriptor& target, const CopyProgress& copied)
{
    Copying copying{copied};
    return copyAll(folder, target, 1, copying);
}

SystemError copyAsNew(const FileDescriptor& from, const FileDescriptor& to, const CopyProgress& copied)
{
    struct stat status;
    if (::fstat(from.get(), &status) != 0)
        return SystemError::last();
    Copying copying{copied, true};
    TRW_TRY(S_ISDIR(status.st_mode) ? copyAll(from, to, 1, copying) : copyContent(from, to, copying));
    return finishAsNew(from, to, status);
}

SystemError copyLink(const FileDescriptor& folder, const std::string& name, const FileDescriptor& target,
    const std::string& newName)
{
    std::array<char, 4096> destination{};
    const auto length = ::readlinkat(folder.get(), name.c_str(), destination.data(), destination.size() - 1);
    return SystemError::unless(
        length >= 0 && ::symlinkat(destination.data(), target.get(), newName.c_str()) == 0, name);
}

SystemResult<std::uint64_t> checkCopyable(const FileDescriptor& folder, const std::string& name)
{
    CopyableCheck check;
    TRW_TRY(walkTree(folder, name, check));
    return check.bytes;
}

bool isSameTree(const FileDescriptor& folder, const std::string& name, const FileDescriptor& otherFolder,
    const std::string& otherName)
{
    return isSameItem({folder, name, otherFolder, otherName}, 0);
}

bool isSameTree(const FileDescriptor& folder, const FileDescriptor& otherFolder)
{
    return holdSame(folder, otherFolder, 1);
}

} // namespace host::drive
