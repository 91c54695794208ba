// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "platform/Error.h"
#include "platform/StorageOffers.h"

#include <optional>
#include <string>

namespace host::drive {

/// What account.json says of the signed-in account.
struct AccountRecord {
    /// Largest account file that is read, in bytes.
    static constexpr std::size_t maximumFileSize = 64 * 1024;

    std::string identity; ///< tells accounts apart, never empty
    std::string displayName;
    std::optional<platform::StorageOffer> storageOffer;

    bool operator==(const AccountRecord&) const = default;

    /// Reads the account's file. Neither a value nor an error: nobody is signed in. An error: the file is
    /// there but cannot be used; it is left as it is. Any thread.
    static platform::Result<AccountRecord> read(const DriveLayout& layout);
    /// The same from the file's text.
    static platform::Result<AccountRecord> parse(const std::string& text, const std::string& path);

    std::string toJson() const;
};

/// The identity that a person's name gives on the local store: the same name always gives the same one.
std::string localIdentity(const std::string& displayName);

} // namespace host::drive
