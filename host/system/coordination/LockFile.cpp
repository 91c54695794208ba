// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/coordination/LockFile.h"

#include "host/system/files/ItemPaths.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <thread>
#include <utility>

namespace host::system {

namespace {

// This is FNV-1a, which is the same in every process and every build. Two paths with one hash merely exclude
// each other without need.
std::int64_t byteOf(std::string_view path)
{
    std::uint64_t hash = 0xcbf29ce484222325U;
    for (const char c : path)
        hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3U;
    return static_cast<std::int64_t>(hash >> 2);
}

using Clock = std::chrono::steady_clock;

/// The pauses of one wait. The kernel's own wait would never end when the holder hangs, so the lock is tried
/// again and again: at once while a short holder may be running, then less and less often.
class Pauses {
public:
    explicit Pauses(platform::Duration patience)
        : _end(Clock::now() + patience)
    {
    }
    /// Answers false when the time is over.
    bool next()
    {
        if (Clock::now() >= _end)
            return false;
        if (_taken++ < yields)
            std::this_thread::yield();
        else
            std::this_thread::sleep_for(std::exchange(_pause, std::min(2 * _pause, longest)));
        return true;
    }

private:
    static constexpr int yields = 32;
    static constexpr Clock::duration longest = std::chrono::milliseconds(10);
    Clock::time_point _end;
    Clock::duration _pause = std::chrono::microseconds(50);
    int _taken = 0;
};

SystemError lockByte(const FileDescriptor& file, std::int64_t byte, LockMode mode, Pauses& pauses)
{
    struct flock lock { };
    lock.l_type = mode == LockMode::Exclusive ? F_WRLCK : F_RDLCK;
    lock.l_whence = SEEK_SET;
    lock.l_start = byte;
    lock.l_len = 1;
    while (::fcntl(file.get(), F_OFD_SETLK, &lock) != 0) {
        if (errno != EINTR && errno != EAGAIN && errno != EACCES)
            return SystemError::last();
        if (!pauses.next())
            return SystemError(EBUSY);
    }
    return {};
}

} // namespace

LockFile::LockFile(std::string path)
    : _path(std::move(path))
{
    if (_path.empty()) {
        _unnamed = FileDescriptor(::memfd_create("coordination", MFD_CLOEXEC));
        _path = "/proc/self/fd/" + std::to_string(_unnamed.get());
    } else {
        ::mkdir(parentPath(_path).c_str(), S_IRWXU);
    }
}

void LockFile::addPath(Bytes& bytes, const Claim& claim)
{
    const std::string_view path = claim.path;
    for (auto slash = path.find('/', 1); slash != std::string_view::npos; slash = path.find('/', slash + 1))
        bytes.emplace(byteOf(path.substr(0, slash)), LockMode::Shared);
    auto& own = bytes.emplace(byteOf(path), claim.mode).first->second;
    if (claim.mode == LockMode::Exclusive)
        own = LockMode::Exclusive;
}

SystemResult<FileDescriptor> LockFile::acquire(
    const std::vector<Claim>& claims, platform::Duration patience) const
{
    Bytes bytes;
    for (const auto& claim : claims)
        addPath(bytes, claim);
    // The path of a file without a name is a link that the kernel makes.
    const int flags = O_RDWR | O_CREAT | O_CLOEXEC | O_NOCTTY | (_unnamed ? 0 : O_NOFOLLOW);
    FileDescriptor file(::open(_path.c_str(), flags, S_IRUSR | S_IWUSR));
    if (!file)
        return SystemError::last(_path).ofDrive();
    Pauses pauses(patience);
    for (const auto& [byte, mode] : bytes) {
        auto failure = lockByte(file, byte, mode, pauses);
        if (failure)
            return failure.is(EBUSY) ? failure : failure.ofDrive();
    }
    return file;
}

} // namespace host::system
