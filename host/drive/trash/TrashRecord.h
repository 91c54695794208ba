// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Trash.h"

#include <optional>
#include <string>
#include <string_view>

namespace host::drive {

/// What is kept beside an item in the trash.
struct TrashRecord {
    using Reason = platform::TrashedItem::Reason;

    /// Larger records are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 8 * 1024;
    /// The name of the record in the item's folder.
    static constexpr const char* fileName = ".trwplace";

    std::string origin; ///< the path of the item below the documents area
    platform::Date trashed;
    Reason reason = Reason::Trashed;

    bool operator==(const TrashRecord&) const = default;

    std::string text() const;
    /// Answers nothing for a text that is no whole record, and for a path that leads out of the documents
    /// area.
    static std::optional<TrashRecord> parse(std::string_view text);
};

} // namespace host::drive
