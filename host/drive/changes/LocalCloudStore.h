// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"

namespace host::drive {

/// Stores contents as files in the drive's own `cloud/` folder, which is made with the first content. A name
/// that could lead out of the folder is refused (ENOENT).
class LocalCloudStore : public CloudStore {
public:
    explicit LocalCloudStore(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    system::SystemError fetch(
        const std::string& content, const system::FileDescriptor& into, const Progress& progress) override;
    system::SystemError store(const DriveEntry& document, const platform::ItemVersion& version,
        const std::string& content) override;
    system::SystemError remove(const std::string& content) override;
    system::SystemError move(const std::string& content, const std::string& newContent) override;
    bool holdsOtherThan(const std::string& content, const system::FileDescriptor& document) override;
    platform::Result<std::vector<std::string>> listChanges(platform::Date since) override;
    platform::Result<StorageSpace> quota() override;

private:
    system::SystemResult<system::FileDescriptor> openFolder() const;
    system::SystemResult<system::FileDescriptor> openContent(const std::string& content) const;

    DriveLayout _layout;
};

} // namespace host::drive
