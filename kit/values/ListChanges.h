// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"

#include <cstddef>
#include <span>
#include <vector>

namespace kit {

/// Rows from `first` on, `count` of them.
struct RowRange {
    std::size_t first = 0;
    std::size_t count = 0;

    std::size_t end() const { return first + count; }
    bool contains(std::size_t index) const { return index >= first && index < end(); }
    bool operator==(const RowRange&) const = default;
};

/// At `position`, `removed` rows go and `inserted` rows come.
struct ListSplice {
    std::size_t position = 0, removed = 0, inserted = 0;
    bool operator==(const ListSplice&) const = default;
};

/// An exact difference between two states of a list.
struct ListChanges {
    /// To be applied one after the other: each position is in the list as the splices before it have left it.
    std::vector<ListSplice> splices;
    /// Rows, by their new indexes, that stayed and show something else.
    std::vector<RowRange> changed;

    bool isEmpty() const { return splices.empty() && changed.empty(); }

    /// The same way in fewer steps: what lies before the rows of a range (of the list as it was) is one
    /// splice, what lies behind them another; those at the rows themselves stay as they are.
    std::vector<ListSplice> splicesExactWithin(const RowRange& range) const;

    /// The shortest way from one order of rows to another: what is in both orders and keeps its sequence
    /// stays, what moves is removed and inserted. Identifiers are unique within an order. n log n.
    static ListChanges between(std::span<const RowId> before, std::span<const RowId> after);
};

} // namespace kit
