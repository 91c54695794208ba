// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// Names a document for another device of the same account.
struct Bookmark {
    /// Longer texts are refused. The limit is in bytes.
    static constexpr std::size_t maximumLength = 4096;

    std::string account; ///< the account's identity
    std::string container;
    std::string path; ///< below the container's documents folder, made of plain names
    std::uint32_t documentIdentifier = 0; ///< 0: none

    bool operator==(const Bookmark&) const = default;

    std::string encoded() const;
    /// Answers nothing for a text that is too long or not a bookmark.
    static std::optional<Bookmark> decode(std::string_view text);
};

} // namespace host::drive
