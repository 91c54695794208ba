// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/DriveNames.h"
#include "platform/Attributes.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host::drive {

/// The attributes that a promise stores for its item. An attribute that is missing or cannot be right is
/// unknown.
struct PromiseRecord {
    /// Larger promises are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 64 * 1024;
    static constexpr std::string_view suffix = system::promiseSuffix;

    enum class Kind : std::uint8_t { File, Directory, Package };

    Kind kind = Kind::File;
    std::optional<std::uint64_t> size; ///< bytes
    std::optional<platform::Date> created;
    std::optional<platform::Date> modified;
    std::string type; ///< uniform type identifier; empty: decided by the name
    bool shared = false;
    std::optional<platform::SharedItemRole> role;
    bool extensionHidden = false;
    std::uint32_t documentIdentifier = 0; ///< 0: none
    std::vector<std::string> tags;
    std::string content; ///< name of the content in the account's cloud folder; empty: there is none
    /// The item's name, where it is too long for the name of the promise to say it. It is only written;
    /// system::promisedName() reads it.
    std::string longName;

    bool operator==(const PromiseRecord&) const = default;

    /// Parses a promise's text. Answers nothing when it is not a single, whole JSON object.
    static std::optional<PromiseRecord> parse(std::string_view text);
    std::string toJson() const;
    /// Parses and writes the short form, which has at most 60 bytes when the content's name has at most 29:
    /// an inode of ext4 has room for 64. It is the byte 2, the kind (0 file, 1 directory, 2 package), a byte
    /// of flags (1: the size is known, 2: the day of the making, 4: the day of the last change), these three
    /// numbers in 8 bytes each and the identifier in 4, the least byte first, and the content's name. The
    /// other members are not in it.
    static std::optional<PromiseRecord> parseShortForm(std::string_view form);
    std::string shortForm() const;

    /// Answers the path of an item's promise, which is a hidden file beside it.
    static std::string pathFor(std::string_view itemPath);
    /// Answers whether a name has the form of a promise's.
    static bool isPromiseName(std::string_view name);
    /// Answers the path of the item for which the promise at this path stands, or nothing when the name is
    /// not a promise's. The name of an item that is too long for that is read from the promise.
    static std::optional<std::string> itemPathFor(std::string_view promisePath);
};

} // namespace host::drive
