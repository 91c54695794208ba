// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "platform/Error.h"
#include "platform/StorageOffers.h"

#include <optional>
#include <string>

namespace host::drive {

/// The content of account.json, which describes the signed-in account.
struct AccountRecord {
    /// Larger account files are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 64 * 1024;

    std::string identity; ///< identifies the account, never empty
    std::string displayName;
    std::optional<platform::StorageOffer> storageOffer;

    bool operator==(const AccountRecord&) const = default;

    /// Reads the account's file. Neither a value nor an error means that nobody is signed in. An error means
    /// that the file exists but cannot be used; it is left as it is. Any thread.
    static platform::Result<AccountRecord> read(const DriveLayout& layout);
    /// Parses the file's text.
    static platform::Result<AccountRecord> parse(const std::string& content, const std::string& path);

    std::string toJson() const;
};

/// Answers the identity that a person's name gives on the local store. The same name always gives the same
/// identity.
std::string localIdentity(const std::string& displayName);

} // namespace host::drive
