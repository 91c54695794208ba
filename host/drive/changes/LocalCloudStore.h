// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"

namespace host::drive {

/// Stores contents as files and folders in the drive's own `cloud/` folder, which is made with the first
/// content. A name that could lead out of the folder is refused (ENOENT).
class LocalCloudStore : public CloudStore {
public:
    explicit LocalCloudStore(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }
    /// Sets what is called after each release, on the releasing thread. It is set before the store is used.
    void onRelease(std::function<void()> released) { _released = std::move(released); }

    system::SystemError fetch(
        const std::string& content, const system::FileDescriptor& into, const Progress& progress) override;
    system::SystemError store(
        const DriveEntry& document, const TreeVersions& versions, const std::string& content) override;
    system::SystemError release(const std::string& content) override;
    std::optional<bool> has(const std::string& content) override;
    bool holdsOtherThan(const std::string& content, const system::FileDescriptor& document) override;
    platform::Result<StorageSpace> quota() override;

private:
    system::SystemResult<system::FileDescriptor> openContent(const std::string& content) const;

    DriveLayout _layout;
    std::function<void()> _released = [] {};
};

} // namespace host::drive
