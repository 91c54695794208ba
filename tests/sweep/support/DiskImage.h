// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <string>

namespace sweep_tests {

/// Makes a small, empty ext4 file system in a file. Answers whether it could.
bool makeDiskImage(const std::string& image);

/// The file system in a file, mounted at a folder for as long as this lives. Only this process and those that
/// it starts see the mount, so it ends with them, however they end. What is not synced stays in memory until
/// then, and a file that is renamed over another one is not synced by the file system itself.
class MountedDisk {
public:
    /// Answers null where this process may not mount, or lacks the tools.
    static std::unique_ptr<MountedDisk> mount(const std::string& image, const std::string& folder);
    MountedDisk(const MountedDisk&) = delete;
    MountedDisk& operator=(const MountedDisk&) = delete;
    ~MountedDisk();

    /// Writes everything to the image.
    void sync() const;
    /// Syncs a file of another program, which brings every name on the disk up to date, but not every
    /// content.
    void syncOtherFile() const;

private:
    explicit MountedDisk(std::string folder)
        : _folder(std::move(folder))
    {
    }
    std::string _folder;
};

} // namespace sweep_tests
