// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListChanges.h"

#include <optional>
#include <string_view>

namespace kit {

class ListView;

/// Answers the rows of a list. It is asked on the main thread, only for rows that are about to be seen, so an
/// answer must come from memory. Facts that take longer are fetched after `visibleRowsDidChange` and reported
/// with `rowChanged`.
class ListViewDataSource {
public:
    virtual ~ListViewDataSource() = default;

    virtual std::size_t numberOfRows(const ListView& list) const = 0;
    /// `index` is below the number of rows.
    virtual ListRow rowAtIndex(const ListView& list, std::size_t index) const = 0;
    /// Answers the same identifier and kind as `rowAtIndex`, without making the row.
    virtual RowId rowIdAtIndex(const ListView& list, std::size_t index) const = 0;
    virtual RowKind rowKindAtIndex(const ListView&, std::size_t /*index*/) const { return RowKind::Item; }
    /// Serves typing ahead. Answers the first row at or after `from`, and then from the top, whose name
    /// begins with the text regardless of case and accents, or nothing.
    virtual std::optional<std::size_t> rowBeginningWith(
        const ListView&, std::string_view /*text*/, std::size_t /*from*/) const
    {
        return std::nullopt;
    }
};

} // namespace kit
