// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/AtomicWrite.h"

#include "host/system/files/ItemPaths.h"
#include "host/system/files/SystemErrors.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdio>

namespace host::system {

using platform::Error;

namespace {

SystemResult<FileDescriptor> openParent(const std::string& path)
{
    FileDescriptor folder(::open(parentPath(path).c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (!folder)
        return SystemError::last(path);
    return folder;
}

/// Answers the access rights of the present file under the name.
mode_t modeToKeep(const FileDescriptor& folder, const std::string& name)
{
    struct stat found;
    const bool isThere = ::fstatat(folder.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) == 0;
    return isThere && S_ISREG(found.st_mode) ? found.st_mode & 0777 : S_IRUSR | S_IWUSR;
}

enum class Purpose {
    Replace, ///< replaces an existing file; the content must not be lost
    Make, ///< makes a new file, which could be made again
};

/// Writes the whole content under the temporary name.
SystemError writeTemporary(const FileDescriptor& folder, const std::string& name, mode_t mode,
    std::string_view content, Purpose purpose)
{
    constexpr int flags = O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC | O_NOFOLLOW;
    const FileDescriptor file(::openat(folder.get(), name.c_str(), flags, S_IRUSR | S_IWUSR));
    if (!file)
        return SystemError::last(name);
    TRW_TRY(writeWhole(file, content));
    const bool isDone =
        ::fchmod(file.get(), mode) == 0 && (purpose == Purpose::Make || ::fsync(file.get()) == 0);
    return SystemError::unless(isDone, name);
}

SystemError write(
    const FileDescriptor& folder, const std::string& name, std::string_view content, Purpose purpose)
{
    const unsigned flags = purpose == Purpose::Make ? RENAME_NOREPLACE : 0;
    const auto temporary = uniqueName(".trwtmp-");
    auto failure = writeTemporary(folder, temporary, modeToKeep(folder, name), content, purpose);
    if (!failure && ::renameat2(folder.get(), temporary.c_str(), folder.get(), name.c_str(), flags) != 0)
        failure = SystemError::last(name);
    if (failure) {
        ::unlinkat(folder.get(), temporary.c_str(), 0);
        return failure;
    }
    return purpose == Purpose::Replace ? syncFolder(folder) : SystemError();
}

std::optional<Error> write(const std::string& path, std::string_view content, Purpose purpose)
{
    const auto folder = openParent(path);
    const auto failure =
        folder ? write(*folder, std::string(lastName(path)), content, purpose) : folder.error;
    return failure ? std::optional(systemError(failure, path)) : std::nullopt;
}

} // namespace

std::optional<Error> writeFileAtomically(const std::string& path, std::string_view content)
{
    return write(path, content, Purpose::Replace);
}

SystemError writeFileAtomically(
    const FileDescriptor& folder, const std::string& name, std::string_view content)
{
    return write(folder, name, content, Purpose::Replace);
}

std::optional<Error> writeNewFileAtomically(const std::string& path, std::string_view content)
{
    return write(path, content, Purpose::Make);
}

SystemError writeWhole(const FileDescriptor& file, std::string_view content)
{
    while (!content.empty()) {
        const auto written = ::write(file.get(), content.data(), content.size());
        if (written < 0 && errno != EINTR)
            return SystemError::last();
        content.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
    }
    return {};
}

SystemError syncFolder(const FileDescriptor& folder)
{
    // fsync refuses descriptors that were opened with O_PATH, so the folder is opened again.
    const FileDescriptor readable(::openat(folder.get(), ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    return SystemError::unless(readable && ::fsync(readable.get()) == 0);
}

std::string uniqueName(std::string_view prefix)
{
    static std::atomic<unsigned> counter = 0;
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    char name[80];
    std::snprintf(name, sizeof name, "%x-%lx%lx-%x", static_cast<unsigned>(getpid()),
        static_cast<unsigned long>(now.tv_sec), static_cast<unsigned long>(now.tv_nsec), counter++);
    return std::string(prefix).append(name);
}

platform::Result<std::string> readWholeFile(const std::string& path, std::size_t maximumBytes)
{
    const auto folder = openParent(path);
    if (!folder)
        return systemError(folder.error, path);
    auto content = readWholeFile(*folder, std::string(lastName(path)), maximumBytes);
    if (!content)
        return systemError(content.error, path);
    return std::move(*content);
}

SystemResult<std::string> readWholeFile(
    const FileDescriptor& folder, const std::string& name, std::size_t maximumBytes)
{
    // Without O_NONBLOCK, opening a named pipe would block until another program writes to it.
    constexpr int flags = O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;
    const FileDescriptor file(::openat(folder.get(), name.c_str(), flags));
    struct stat found;
    if (!file || ::fstat(file.get(), &found) != 0)
        return SystemError::last(name);
    if (!S_ISREG(found.st_mode))
        return SystemError(S_ISDIR(found.st_mode) ? EISDIR : ENXIO, name);
    std::string content;
    char piece[16 * 1024];
    for (;;) {
        const auto length = ::read(file.get(), piece, sizeof piece);
        if (length == 0)
            return content;
        if (length < 0 && errno == EINTR)
            continue;
        if (length < 0)
            return SystemError::last(name);
        content.append(piece, static_cast<std::size_t>(length));
        if (content.size() > maximumBytes)
            return SystemError(EFBIG, name);
    }
}

} // namespace host::system
