// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/DiskImage.h"

#include "host/system/files/FileDescriptor.h"

#include <fcntl.h>
#include <linux/loop.h>
#include <sched.h>
#include <sys/ioctl.h>
#include <sys/mount.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>

namespace sweep_tests {

namespace {

using host::system::FileDescriptor;

/// Gives this process mounts of its own. Answers whether it may mount.
bool mountsAreOwn()
{
    static const bool areOwn =
        ::unshare(CLONE_NEWNS) == 0 && ::mount("none", "/", nullptr, MS_REC | MS_PRIVATE, nullptr) == 0;
    return areOwn;
}

/// Makes a block device of a file, which ends with its last use. Answers the device's path, empty when that
/// is impossible.
std::string blockDevice(const FileDescriptor& image, FileDescriptor& device)
{
    const FileDescriptor control(::open("/dev/loop-control", O_RDWR | O_CLOEXEC));
    for (int tries = 0; control && tries < 16; ++tries) {
        const auto path = "/dev/loop" + std::to_string(::ioctl(control.get(), LOOP_CTL_GET_FREE));
        device = FileDescriptor(::open(path.c_str(), O_RDWR | O_CLOEXEC));
        loop_config config{};
        config.fd = static_cast<unsigned>(image.get());
        config.info.lo_flags = LO_FLAGS_AUTOCLEAR;
        if (device && ::ioctl(device.get(), LOOP_CONFIGURE, &config) == 0)
            return path;
        if (errno != EBUSY) // another process may have taken it
            break;
    }
    return {};
}

} // namespace

bool makeDiskImage(const std::string& image)
{
    constexpr off_t size = off_t{8} << 20;
    const FileDescriptor file(::open(image.c_str(), O_RDWR | O_CREAT | O_TRUNC | O_CLOEXEC, 0600));
    if (!file || ::ftruncate(file.get(), size) != 0)
        return false;
    const auto process = ::fork();
    if (process == 0) {
        ::execl("/sbin/mkfs.ext4", "mkfs.ext4", "-q", "-m", "0", image.c_str(), nullptr);
        ::_exit(127);
    }
    int status = -1;
    return ::waitpid(process, &status, 0) == process && status == 0;
}

std::unique_ptr<MountedDisk> MountedDisk::mount(const std::string& image, const std::string& folder)
{
    const FileDescriptor file(::open(image.c_str(), O_RDWR | O_CLOEXEC));
    FileDescriptor device;
    const auto path = file && mountsAreOwn() ? blockDevice(file, device) : std::string();
    // The file system writes by itself only after an hour.
    if (path.empty()
        || ::mount(path.c_str(), folder.c_str(), "ext4", MS_NOATIME, "noauto_da_alloc,commit=3600") != 0)
        return nullptr;
    ::rmdir((folder + "/lost+found").c_str());
    return std::unique_ptr<MountedDisk>(new MountedDisk(folder));
}

MountedDisk::~MountedDisk()
{
    constexpr int most = 100;
    for (int tries = 0; ::umount2(_folder.c_str(), 0) != 0 && errno == EBUSY && tries < most; ++tries)
        ::usleep(10'000); // a program that was just killed may still be ending
}

void MountedDisk::sync() const
{
    const FileDescriptor folder(::open(_folder.c_str(), O_RDONLY | O_CLOEXEC));
    ::syncfs(folder.get());
}

void MountedDisk::syncOtherFile() const
{
    const FileDescriptor file(::open(_folder.c_str(), O_WRONLY | O_TMPFILE | O_CLOEXEC, 0600));
    static_cast<void>(::write(file.get(), "x", 1));
    ::fsync(file.get());
}

} // namespace sweep_tests
