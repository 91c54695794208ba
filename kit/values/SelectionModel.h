// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/RowIdSet.h"

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

namespace kit {

/// Which rows are selected, by identifier, so that a selection outlives every change of order. A value that
/// knows no list and no widget.
class SelectionModel {
public:
    bool contains(RowId id) const { return _ids.contains(id); }
    std::size_t count() const { return _ids.size(); }
    bool isEmpty() const { return _ids.empty(); }

    void select(RowId id);
    void deselect(RowId id);
    /// True when the row is selected afterwards. The row becomes the start of the next range.
    bool toggle(RowId id);
    void selectOnly(RowId id);
    void selectAll(std::span<const RowId> order);
    /// Makes everything from the row touched last to this one, both included, what the row touched last is:
    /// selected or not. A further call replaces the range of the one before. Without such a row this one
    /// alone is selected.
    void extendTo(RowId id, std::span<const RowId> order);
    void clear();

    /// Forgets what is not in the list any more. True when something was forgotten.
    bool keepOnly(std::span<const RowId> order);
    /// The selected rows in the order of the list.
    std::vector<RowId> inOrder(std::span<const RowId> order) const;

    bool operator==(const SelectionModel& other) const { return _ids == other._ids; }

private:
    /// A range that is being drawn, and what was selected before it.
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
