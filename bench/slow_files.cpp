// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This library, when preloaded, makes a folder as slow as a disk that is far away or asleep.
//
// LD_PRELOAD=libslow_files.so SLOW_FOLDER=/home/mira/drive SLOW_SWITCH=/tmp/slow PROGRAM delays every call
// for a file below the folder by half a second (SLOW_MS milliseconds) while the file of SLOW_SWITCH exists,
// and prints a line on standard error for each such call of the main thread. With SLOW_TRACE=1 the line is
// followed by who called. Beside libloop_gaps.so it shows what of that a person feels.

#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <execinfo.h>
#include <fcntl.h>
#include <string>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/xattr.h>
#include <time.h>
#include <unistd.h>

namespace {

template <typename Function>
Function next(const char* name)
{
    return reinterpret_cast<Function>(dlsym(RTLD_NEXT, name));
}

std::string setting(const char* name, const char* otherwise)
{
    const char* value = std::getenv(name);
    return value ? value : otherwise;
}

/// Answers the path of an open file, or nothing for what is no file.
std::string pathOf(int file)
{
    char path[4096];
    const auto link = "/proc/self/fd/" + std::to_string(file);
    const auto length = syscall(SYS_readlinkat, AT_FDCWD, link.c_str(), path, sizeof path);
    return length > 0 ? std::string(path, static_cast<std::size_t>(length)) : std::string();
}

std::string pathAt(int folder, const char* path)
{
    if (!path || !*path)
        return pathOf(folder);
    return *path == '/' || folder == AT_FDCWD ? std::string(path) : pathOf(folder) + '/' + path;
}

/// Delays a call for a file below the folder.
void delay(const char* call, const std::string& path)
{
    static const auto folder = setting("SLOW_FOLDER", "/nowhere"), trigger = setting("SLOW_SWITCH", "/");
    static const bool traces = !setting("SLOW_TRACE", "").empty();
    static const long milliseconds = std::atol(setting("SLOW_MS", "500").c_str());
    if (!path.starts_with(folder) || syscall(SYS_access, trigger.c_str(), F_OK) != 0)
        return;
    if (getpid() == syscall(SYS_gettid)) {
        std::fprintf(stderr, "main thread: %s %s\n", call, path.c_str() + folder.size());
        void* frames[40];
        if (traces)
            backtrace_symbols_fd(frames, backtrace(frames, 40), STDERR_FILENO);
    }
    const timespec pause{milliseconds / 1000, (milliseconds % 1000) * 1'000'000};
    nanosleep(&pause, nullptr);
}

mode_t modeOf(int flags, va_list arguments)
{
    return (flags & (O_CREAT | O_TMPFILE)) ? va_arg(arguments, mode_t) : 0;
}

} // namespace

// NOLINTBEGIN(readability-inconsistent-declaration-parameter-name): names of the library

extern "C" {

int open(const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const auto mode = modeOf(flags, arguments);
    va_end(arguments);
    static const auto real = next<int (*)(const char*, int, ...)>("open");
    delay("open", path);
    return real(path, flags, mode);
}

int openat(int folder, const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const auto mode = modeOf(flags, arguments);
    va_end(arguments);
    static const auto real = next<int (*)(int, const char*, int, ...)>("openat");
    delay("openat", pathAt(folder, path));
    return real(folder, path, flags, mode);
}

int open64(const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const auto mode = modeOf(flags, arguments);
    va_end(arguments);
    static const auto real = next<int (*)(const char*, int, ...)>("open64");
    delay("open64", path);
    return real(path, flags, mode);
}

#define SLOW_AT_PATH(name, type, parameters, arguments, path)                                                \
    type name parameters                                                                                     \
    {                                                                                                        \
        static const auto real = next<type(*) parameters>(#name);                                            \
        delay(#name, path);                                                                                  \
        return real arguments;                                                                               \
    }

using Stat = struct stat;
using Statx = struct statx;

SLOW_AT_PATH(stat, int, (const char* path, Stat* to), (path, to), path)
SLOW_AT_PATH(lstat, int, (const char* path, Stat* to), (path, to), path)
SLOW_AT_PATH(fstat, int, (int file, Stat* to), (file, to), pathOf(file))
SLOW_AT_PATH(fstatat, int, (int folder, const char* path, Stat* to, int flags), (folder, path, to, flags),
    pathAt(folder, path))
SLOW_AT_PATH(statx, int, (int folder, const char* path, int flags, unsigned mask, Statx* to),
    (folder, path, flags, mask, to), pathAt(folder, path))
SLOW_AT_PATH(access, int, (const char* path, int mode), (path, mode), path)
SLOW_AT_PATH(faccessat, int, (int folder, const char* path, int mode, int flags), (folder, path, mode, flags),
    pathAt(folder, path))
SLOW_AT_PATH(getxattr, ssize_t, (const char* path, const char* name, void* to, size_t size),
    (path, name, to, size), path)
SLOW_AT_PATH(lgetxattr, ssize_t, (const char* path, const char* name, void* to, size_t size),
    (path, name, to, size), path)
SLOW_AT_PATH(fgetxattr, ssize_t, (int file, const char* name, void* to, size_t size), (file, name, to, size),
    pathOf(file))
SLOW_AT_PATH(readlink, ssize_t, (const char* path, char* to, size_t size), (path, to, size), path)
SLOW_AT_PATH(readlinkat, ssize_t, (int folder, const char* path, char* to, size_t size),
    (folder, path, to, size), pathAt(folder, path))
SLOW_AT_PATH(rename, int, (const char* from, const char* to), (from, to), from)
SLOW_AT_PATH(renameat2, int, (int fromFolder, const char* from, int toFolder, const char* to, unsigned flags),
    (fromFolder, from, toFolder, to, flags), pathAt(fromFolder, from))
SLOW_AT_PATH(
    unlinkat, int, (int folder, const char* path, int flags), (folder, path, flags), pathAt(folder, path))
SLOW_AT_PATH(
    mkdirat, int, (int folder, const char* path, mode_t mode), (folder, path, mode), pathAt(folder, path))
SLOW_AT_PATH(
    inotify_add_watch, int, (int watcher, const char* path, uint32_t mask), (watcher, path, mask), path)
SLOW_AT_PATH(realpath, char*, (const char* path, char* to), (path, to), path)

} // extern "C"

// NOLINTEND(readability-inconsistent-declaration-parameter-name)
