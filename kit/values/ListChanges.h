// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"

#include <cstddef>
#include <span>
#include <vector>

namespace kit {

/// A range of `count` rows that begins at `first`.
struct RowRange {
    std::size_t first = 0;
    std::size_t count = 0;

    std::size_t end() const { return first + count; }
    bool contains(std::size_t index) const { return index >= first && index < end(); }
    bool operator==(const RowRange&) const = default;
};

/// Says that at `position` `removed` rows go and `inserted` rows come.
struct ListSplice {
    std::size_t position = 0, removed = 0, inserted = 0;
    bool operator==(const ListSplice&) const = default;
};

/// An exact difference between two states of a list.
struct ListChanges {
    /// The splices apply one after the other: each position is in the list as the splices before it have left
    /// it.
    std::vector<ListSplice> splices;
    /// The rows, by their new indexes, that stayed and show something else.
    std::vector<RowRange> changed;

    bool isEmpty() const { return splices.empty() && changed.empty(); }

    /// Answers the same difference in fewer splices. The splices before the rows of a range (of the old list)
    /// become one, and so do the splices behind them; those at the rows themselves stay as they are.
    std::vector<ListSplice> splicesExactWithin(const RowRange& range) const;

    /// Answers the shortest difference between two orders of rows. Rows that are in both orders and keep
    /// their sequence stay; rows that move are removed and inserted. Identifiers are unique within an order.
    /// It takes n log n steps.
    static ListChanges between(std::span<const RowId> before, std::span<const RowId> after);
};

} // namespace kit
