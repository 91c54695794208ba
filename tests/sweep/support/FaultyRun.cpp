// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/FaultyRun.h"

#include <fcntl.h>
#include <linux/audit.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/uio.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <iterator>
#include <stdexcept>

namespace sweep_tests {

namespace {

/// Says how a call names its file.
enum class Form { FolderAndPath, Path, OpenFile };

struct CallKind {
    int number;
    Form form;
    bool mayNeedSpace;
};

constexpr CallKind kinds[] = {
    {SYS_openat, Form::FolderAndPath, false},
    {SYS_openat2, Form::FolderAndPath, false},
    {SYS_newfstatat, Form::FolderAndPath, false},
    {SYS_statx, Form::FolderAndPath, false},
    {SYS_readlinkat, Form::FolderAndPath, false},
    {SYS_faccessat2, Form::FolderAndPath, false},
    {SYS_renameat, Form::FolderAndPath, true},
    {SYS_renameat2, Form::FolderAndPath, true},
    {SYS_unlinkat, Form::FolderAndPath, false},
    {SYS_mkdirat, Form::FolderAndPath, true},
    {SYS_symlinkat, Form::FolderAndPath, true},
    {SYS_linkat, Form::FolderAndPath, true},
    {SYS_utimensat, Form::FolderAndPath, false},
    {SYS_lsetxattr, Form::Path, true},
    {SYS_fsetxattr, Form::OpenFile, true},
    {SYS_flistxattr, Form::OpenFile, false},
    {SYS_fgetxattr, Form::OpenFile, false},
    {SYS_fchmod, Form::OpenFile, false},
    {SYS_ftruncate, Form::OpenFile, true},
    {SYS_fstat, Form::OpenFile, false},
    {SYS_read, Form::OpenFile, false},
    {SYS_write, Form::OpenFile, true},
    {SYS_fsync, Form::OpenFile, true},
    {SYS_fdatasync, Form::OpenFile, true},
    {SYS_lseek, Form::OpenFile, false},
    {SYS_getdents64, Form::OpenFile, false},
#ifdef __x86_64__
    {SYS_open, Form::Path, false},
    {SYS_mkdir, Form::Path, true},
    {SYS_rename, Form::Path, true},
    {SYS_unlink, Form::Path, false},
    {SYS_rmdir, Form::Path, false},
    {SYS_lstat, Form::Path, false},
    {SYS_stat, Form::Path, false},
#endif
};

const CallKind* kindOf(std::uint64_t number)
{
    const auto* found = std::ranges::find(kinds, static_cast<int>(number), &CallKind::number);
    return found == std::end(kinds) ? nullptr : found;
}

/// Runs in the child: asks the kernel to report the calls, and answers the descriptor that reports them.
int installFilter()
{
    std::vector<sock_filter> program{BPF_STMT(BPF_LD | BPF_W | BPF_ABS, offsetof(seccomp_data, nr))};
    for (const auto& kind : kinds) {
        program.push_back(BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, static_cast<unsigned>(kind.number), 0, 1));
        program.push_back(BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_USER_NOTIF));
    }
    program.push_back(BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW));
    const sock_fprog filter{static_cast<unsigned short>(program.size()), program.data()};
    if (::prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0)
        return -1;
    return static_cast<int>(
        ::syscall(SYS_seccomp, SECCOMP_SET_MODE_FILTER, SECCOMP_FILTER_FLAG_NEW_LISTENER, &filter));
}

union Ancillary {
    std::array<char, CMSG_SPACE(sizeof(int))> bytes;
    cmsghdr aligned;
};

void sendDescriptor(int socket, int descriptor)
{
    char nothing = 0;
    iovec piece{&nothing, 1};
    Ancillary ancillary{};
    msghdr message{};
    message.msg_iov = &piece;
    message.msg_iovlen = 1;
    message.msg_control = ancillary.bytes.data();
    message.msg_controllen = ancillary.bytes.size();
    auto* header = CMSG_FIRSTHDR(&message);
    header->cmsg_level = SOL_SOCKET;
    header->cmsg_type = SCM_RIGHTS;
    header->cmsg_len = CMSG_LEN(sizeof descriptor);
    std::memcpy(CMSG_DATA(header), &descriptor, sizeof descriptor);
    ::sendmsg(socket, &message, 0);
}

int receiveDescriptor(int socket)
{
    char nothing = 0;
    iovec piece{&nothing, 1};
    Ancillary ancillary{};
    msghdr message{};
    message.msg_iov = &piece;
    message.msg_iovlen = 1;
    message.msg_control = ancillary.bytes.data();
    message.msg_controllen = ancillary.bytes.size();
    int descriptor = -1;
    if (::recvmsg(socket, &message, MSG_CMSG_CLOEXEC) == 1) {
        if (const auto* header = CMSG_FIRSTHDR(&message))
            std::memcpy(&descriptor, CMSG_DATA(header), sizeof descriptor);
    }
    return descriptor;
}

std::string textAt(pid_t process, std::uint64_t address)
{
    std::array<char, 4096> text{};
    // The text is read up to the end of the page, because the next page may not exist.
    const auto length = std::min<std::uint64_t>(text.size() - 1, 4096 - address % 4096);
    iovec here{text.data(), length}, there{reinterpret_cast<void*>(address), length};
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
    switch (kindOf(call.number)->form) {
    case Form::FolderAndPath:
        call.subject = pathIn(process, arguments[0], textAt(process, arguments[1]));
        if (call.number == SYS_renameat2)
            call.newName = pathIn(process, arguments[2], textAt(process, arguments[3]));
        break;
    case Form::Path:
        call.subject = pathIn(process, static_cast<std::uint64_t>(-1), textAt(process, arguments[0]));
        break;
    case Form::OpenFile:
        call.subject = openFile(process, arguments[0]);
    }
    return call;
}

class Supervisor {
public:
    Supervisor(pid_t process, int listener, std::string folder,
        const std::function<Fault(const FileCall&)>& faultFor)
        : _process(process)
        , _listener(listener)
        , _folder(std::move(folder))
        , _faultFor(faultFor)
    {
    }
    Ending run()
    {
        pollfd reports{_listener, POLLIN, 0};
        // The listener reports a hang-up when no process is left.
        while (::poll(&reports, 1, -1) >= 0 && (reports.revents & POLLIN))
            answerNext();
        int status = 0;
        ::waitpid(_process, &status, 0);
        _ending.wasKilled = WIFSIGNALED(status);
        _ending.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        return _ending;
    }

private:
    void answerNext()
    {
        seccomp_notif notice{};
        if (::ioctl(_listener, SECCOMP_IOCTL_NOTIF_RECV, &notice) != 0)
            return;
        auto call = describe(notice);
        Fault fault;
        if (call.subject.starts_with(_folder)) {
            call.index = ++_ending.calls;
            fault = _faultFor(call);
        }
        if (fault.kind == Fault::Kind::Kill) {
            ::kill(_process, SIGKILL);
            return;
        }
        seccomp_notif_resp answer{};
        answer.id = notice.id;
        if (fault.kind == Fault::Kind::Error)
            answer.error = -fault.errorNumber;
        else
            answer.flags = SECCOMP_USER_NOTIF_FLAG_CONTINUE;
        ::ioctl(_listener, SECCOMP_IOCTL_NOTIF_SEND, &answer);
    }

    pid_t _process;
    int _listener;
    std::string _folder;
    const std::function<Fault(const FileCall&)>& _faultFor;
    Ending _ending;
};

[[noreturn]] void becomeProgram(const std::vector<std::string>& command, int socket)
{
    std::vector<char*> arguments;
    arguments.reserve(command.size() + 1);
    for (const auto& argument : command)
        arguments.push_back(const_cast<char*>(argument.c_str()));
    arguments.push_back(nullptr);
    const int quiet = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
    ::dup2(quiet, STDERR_FILENO);
    ::dup2(quiet, STDOUT_FILENO);
    const int listener = installFilter();
    sendDescriptor(socket, listener);
    if (listener >= 0) {
        ::fcntl(listener, F_SETFD, FD_CLOEXEC);
        ::execv(arguments[0], arguments.data());
    }
    ::_exit(127);
}

} // namespace

bool FileCall::mayNeedSpace() const
{
    return kindOf(number)->mayNeedSpace;
}

bool FileCall::takesPath() const
{
    return kindOf(number)->form != Form::OpenFile;
}

Ending runWithFaults(const std::vector<std::string>& command, const std::string& watchedFolder,
    const std::function<Fault(const FileCall&)>& faultFor)
{
    int sockets[2];
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, sockets) != 0)
        throw std::runtime_error("no pair of sockets");
    const auto process = ::fork();
    if (process == 0)
        becomeProgram(command, sockets[1]);
    ::close(sockets[1]);
    const int listener = receiveDescriptor(sockets[0]);
    ::close(sockets[0]);
    if (listener < 0) {
        ::waitpid(process, nullptr, 0);
        throw std::runtime_error("system calls cannot be filtered here");
    }
    const auto ending = Supervisor(process, listener, watchedFolder, faultFor).run();
    ::close(listener);
    return ending;
}

} // namespace sweep_tests
