// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/RowIdSet.h"

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

namespace kit {

/// The identifiers of the selected rows. A selection keeps its rows when their order changes. A value that
/// knows no list and no widget.
class SelectionModel {
public:
    bool contains(RowId id) const { return _ids.contains(id); }
    std::size_t count() const { return _ids.size(); }
    bool isEmpty() const { return _ids.empty(); }

    void select(RowId id);
    void deselect(RowId id);
    /// Answers whether the row is selected afterwards. The row becomes the start of the next range.
    bool toggle(RowId id);
    void selectAll(std::span<const RowId> order);
    /// Gives every row from the one touched last to this one, both included, the state of the row touched
    /// last: selected or not. A further call replaces the range of the call before. When no row was touched
    /// before, this row alone is selected.
    void extendTo(RowId id, std::span<const RowId> order);
    void clear();

    /// Drops identifiers that are not in the list any more. Answers whether it dropped one.
    bool keepOnly(std::span<const RowId> order);
    /// Answers the selected rows in the order of the list.
    std::vector<RowId> inOrder(std::span<const RowId> order) const;

    bool operator==(const SelectionModel& other) const { return _ids == other._ids; }

private:
    /// The range that is being extended, and the selection before it began.
    struct Range {
        RowIdSet before;
        bool selects;
    };
    void touch(RowId id);

    RowIdSet _ids;
    std::optional<RowId> _anchor; ///< the row touched last
    std::optional<Range> _range;
};

} // namespace kit
