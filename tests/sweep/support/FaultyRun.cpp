// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/FaultyRun.h"

#include "host/system/files/FileDescriptor.h"

#include <fcntl.h>
#include <linux/audit.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <poll.h>
#include <sched.h>
#include <sys/ioctl.h>
#include <sys/mman.h>
#include <sys/prctl.h>
#include <sys/syscall.h>
#include <sys/uio.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <span>
#include <stdexcept>

namespace sweep_tests {

namespace {

using host::system::FileDescriptor;

constexpr int namedInFolder[] = {SYS_openat, SYS_openat2, SYS_newfstatat, SYS_statx, SYS_readlinkat,
    SYS_faccessat2, SYS_renameat, SYS_renameat2, SYS_unlinkat, SYS_mkdirat, SYS_symlinkat, SYS_linkat,
    SYS_utimensat};
constexpr int namedByPath[] = {SYS_setxattr, SYS_lsetxattr, SYS_getxattr, SYS_lgetxattr, SYS_listxattr,
    SYS_llistxattr, SYS_removexattr, SYS_lremovexattr,
#ifdef __x86_64__
    SYS_mkdir, SYS_rename, SYS_unlink, SYS_rmdir, SYS_readlink
#endif
};
constexpr int ofOpenFile[] = {SYS_fsetxattr, SYS_flistxattr, SYS_fgetxattr, SYS_fremovexattr, SYS_fchmod,
    SYS_ftruncate, SYS_fallocate, SYS_fstat, SYS_read, SYS_pread64, SYS_write, SYS_pwrite64, SYS_fsync,
    SYS_fdatasync, SYS_lseek, SYS_getdents64};
constexpr int changingNames[] = {SYS_renameat, SYS_renameat2, SYS_unlinkat,
#ifdef __x86_64__
    SYS_rename, SYS_unlink, SYS_rmdir
#endif
};
constexpr int transferring[] = {SYS_read, SYS_pread64, SYS_write};
constexpr int opening[] = {SYS_openat, SYS_openat2};
constexpr std::span<const int> watched[] = {namedInFolder, namedByPath, ofOpenFile};
constexpr int needingSpace[] = {
    SYS_renameat, SYS_renameat2, SYS_mkdirat, SYS_symlinkat, SYS_linkat, SYS_setxattr, SYS_lsetxattr,
    SYS_fsetxattr, SYS_ftruncate, SYS_fallocate, SYS_write, SYS_pwrite64, SYS_fsync, SYS_fdatasync,
#ifdef __x86_64__
    SYS_mkdir, SYS_rename
#endif
};

bool isAmong(std::span<const int> calls, std::uint64_t number)
{
    return std::ranges::find(calls, static_cast<int>(number)) != calls.end();
}

/// Runs in the child: asks the kernel to report the calls, and answers the descriptor that reports them.
int installFilter()
{
    std::vector<sock_filter> program{BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr))};
    for (const auto& calls : watched) {
        for (const int call : calls) {
            program.push_back(BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, static_cast<unsigned>(call), 0, 1));
            program.push_back(BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_USER_NOTIF));
        }
    }
    program.push_back(BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW));
    const sock_fprog filter{static_cast<unsigned short>(program.size()), program.data()};
    if (::prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0)
        return -1;
    return static_cast<int>(
        ::syscall(SYS_seccomp, SECCOMP_SET_MODE_FILTER, SECCOMP_FILTER_FLAG_NEW_LISTENER, &filter));
}

std::string textAt(pid_t process, std::uint64_t address)
{
    std::array<char, 4096> text{};
    // The text is read up to the end of the page, because the next page may not exist.
    const auto length = std::min<std::uint64_t>(text.size() - 1, 4096 - address % 4096);
    const iovec here{text.data(), length};
    const iovec there{reinterpret_cast<void*>(address), length};
    if (::process_vm_readv(process, &here, 1, &there, 1, 0) < 0)
        return {};
    return text.data();
}

std::string openFile(pid_t process, std::uint64_t descriptor)
{
    const auto link =
        "/proc/" + std::to_string(process) + "/fd/" + std::to_string(static_cast<int>(descriptor));
    std::array<char, 4096> path{};
    const auto length = ::readlink(link.c_str(), path.data(), path.size() - 1);
    return length > 0 ? std::string(path.data(), static_cast<std::size_t>(length)) : std::string();
}

/// Answers the path that a call names, relative to the open folder that the call names with it.
std::string pathIn(pid_t process, std::uint64_t folder, const std::string& path)
{
    constexpr std::string_view ownDescriptor = "/proc/self/fd/";
    if (path.starts_with(ownDescriptor)) {
        const auto slash = path.find('/', ownDescriptor.size());
        const auto number = std::stoul(path.substr(ownDescriptor.size()));
        return openFile(process, number) + (slash == std::string::npos ? "" : path.substr(slash));
    }
    if (path.starts_with('/') || static_cast<int>(folder) < 0)
        return path;
    const auto above = openFile(process, folder);
    return path.empty() || path == "." ? above : above + '/' + path;
}

FileCall describe(const seccomp_notif& notice)
{
    const auto process = static_cast<pid_t>(notice.pid);
    const auto& arguments = notice.data.args;
    FileCall call;
    call.number = static_cast<std::uint64_t>(notice.data.nr);
    if (isAmong(ofOpenFile, call.number))
        call.subject = openFile(process, arguments[0]);
    else if (isAmong(namedByPath, call.number))
        call.subject = pathIn(process, static_cast<std::uint64_t>(-1), textAt(process, arguments[0]));
    else
        call.subject = pathIn(process, arguments[0], textAt(process, arguments[1]));
    if (call.number == SYS_renameat2)
        call.newName = pathIn(process, arguments[2], textAt(process, arguments[3]));
    if (call.isTransfer())
        call.length = arguments[2];
    return call;
}

/// Makes a process's read or write in its place, with the same open file, for one byte. Answers the count, or
/// a negative error number.
int transferOneByte(pid_t process, const seccomp_data& call)
{
    const FileDescriptor place(static_cast<int>(::syscall(SYS_pidfd_open, process, 0)));
    const FileDescriptor file(
        static_cast<int>(::syscall(SYS_pidfd_getfd, place.get(), static_cast<int>(call.args[0]), 0)));
    char byte = 0;
    const iovec here{&byte, 1}, there{reinterpret_cast<void*>(call.args[1]), 1};
    ssize_t count = -1;
    if (call.nr == SYS_write)
        count = ::process_vm_readv(process, &here, 1, &there, 1, 0) == 1 ? ::write(file.get(), &byte, 1) : -1;
    else if (call.nr == SYS_read)
        count = ::read(file.get(), &byte, 1);
    else
        count = ::pread(file.get(), &byte, 1, static_cast<off_t>(call.args[3]));
    if (count == 1 && call.nr != SYS_write)
        count = ::process_vm_writev(process, &here, 1, &there, 1, 0);
    return count < 0 ? -errno : static_cast<int>(count);
}

void answer(int listener, pid_t process, const seccomp_notif& notice, const Fault& fault)
{
    seccomp_notif_resp response{};
    response.id = notice.id;
    const int count = fault.isShort ? transferOneByte(process, notice.data) : -fault.errorNumber;
    if (count < 0)
        response.error = count;
    else
        response.val = count;
    response.flags = fault.isNone() ? SECCOMP_USER_NOTIF_FLAG_CONTINUE : 0;
    ::ioctl(listener, SECCOMP_IOCTL_NOTIF_SEND, &response);
}

/// Answers what was written into a file in memory.
std::string wholeText(const FileDescriptor& file)
{
    std::string text(static_cast<std::size_t>(std::max<off_t>(::lseek(file.get(), 0, SEEK_END), 0)), '\0');
    const auto length = ::pread(file.get(), text.data(), text.size(), 0);
    text.resize(static_cast<std::size_t>(std::max<ssize_t>(length, 0)));
    return text;
}

Ending supervise(pid_t process, int listener, const std::string& folder, const FaultFor& faultFor)
{
    Ending ending;
    pollfd reports{listener, POLLIN, 0};
    // The listener reports a hang-up when no process is left.
    while (::poll(&reports, 1, -1) >= 0 && (reports.revents & POLLIN)) {
        seccomp_notif notice{};
        if (::ioctl(listener, SECCOMP_IOCTL_NOTIF_RECV, &notice) != 0)
            continue;
        auto call = describe(notice);
        Fault fault;
        if (call.subject.starts_with(folder)) {
            call.index = ++ending.calls;
            fault = faultFor(call);
        }
        if (fault.isKill)
            ::kill(process, SIGKILL);
        else
            answer(listener, process, notice, fault);
    }
    int status = 0;
    ::waitpid(process, &status, 0);
    ending.wasKilled = WIFSIGNALED(status);
    ending.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return ending;
}

/// Runs in the child, which shares its open files with this process until it becomes the program: puts the
/// listener in the place of an open file.
[[noreturn]] void becomeProgram(const std::vector<std::string>& command, int said, int listenersPlace)
{
    std::vector<char*> arguments;
    for (const auto& argument : command)
        arguments.push_back(const_cast<char*>(argument.c_str()));
    arguments.push_back(nullptr);
    const int listener = installFilter();
    if (::dup3(listener, listenersPlace, O_CLOEXEC) >= 0 && ::close(listener) == 0
        && ::unshare(CLONE_FILES) == 0) {
        ::dup2(said, STDERR_FILENO);
        ::dup2(said, STDOUT_FILENO);
        ::execv(arguments[0], arguments.data());
    }
    ::_exit(127);
}

} // namespace

bool FileCall::mayNeedSpace() const
{
    return isAmong(needingSpace, number);
}

bool FileCall::changesNames() const
{
    return isAmong(changingNames, number);
}

bool FileCall::takesPath() const
{
    return !isAmong(ofOpenFile, number);
}

bool FileCall::opensFile() const
{
    return isAmong(opening, number);
}

bool FileCall::isTransfer() const
{
    return isAmong(transferring, number);
}

Ending runWithFaults(
    const std::vector<std::string>& command, const std::string& watchedFolder, const FaultFor& faultFor)
{
    const FileDescriptor said(::memfd_create("said", MFD_CLOEXEC));
    const FileDescriptor listener(::open("/dev/null", O_WRONLY | O_CLOEXEC));
    // This process goes on when the child has become the program, and not before.
    const auto process =
        static_cast<pid_t>(::syscall(SYS_clone, CLONE_FILES | CLONE_VFORK | SIGCHLD, 0, 0, 0, 0));
    if (process == 0)
        becomeProgram(command, said.get(), listener.get());
    if (::waitpid(process, nullptr, WNOHANG) != 0)
        throw std::runtime_error("system calls cannot be filtered here");
    auto ending = supervise(process, listener.get(), watchedFolder, faultFor);
    ending.said = wholeText(said);
    return ending;
}

} // namespace sweep_tests
