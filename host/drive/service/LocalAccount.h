// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "platform/CloudAccount.h"

#include <mutex>

namespace host::drive {

/// The account in account.json, with the free space of the file system that holds the drive.
class LocalAccount : public platform::CloudAccount {
public:
    explicit LocalAccount(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    std::optional<platform::PropertyValue> identityToken() const override;
    std::optional<platform::PropertyValue> knownIdentityToken() const override;
    platform::Work makeQuotaFetchOperation(
        std::function<void(platform::Result<std::int64_t>)> completion) const override;

private:
    const DriveLayout _layout;
    mutable std::mutex _mutex;
    mutable std::optional<std::optional<platform::PropertyValue>> _known; ///< absent before the first reading
};

} // namespace host::drive
