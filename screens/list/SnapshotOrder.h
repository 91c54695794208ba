// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "screens/PlatformNames.h"
#include "screens/list/ListOrder.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

namespace screens {

class KindRanks;

/// The rows of a snapshot's entries in an order. Equal entries stay in the order of their names. A value.
/// Making one reads every item's attributes when the order needs them, which belongs off the main thread.
class SnapshotOrder {
public:
    using Indexes = std::vector<std::uint32_t>;
    /// The effect of a revision on the rows: `removed` are old rows, `inserted` and `touched` new ones, of
    /// which the touched may show something else. All are in rising order.
    struct Step {
        Indexes removed, inserted, touched;
    };

    SnapshotOrder(const FolderSnapshot& snapshot, const ListOrder& order);

    const ListOrder& order() const { return _order; }
    /// Answers the index in the snapshot of the entry in a row.
    std::size_t index(std::size_t row) const { return _indexes.empty() ? row : _indexes[row]; }

    /// Answers the same order for a revision of the snapshot; only the items that the revision names are
    /// read. Answers nothing when the order has to be made anew.
    std::optional<SnapshotOrder> revised(const FolderSnapshot& after, Step& step) const;

private:
    class Merge;
    SnapshotOrder() = default;
    std::optional<std::int64_t> keyOf(const FolderSnapshot& snapshot, std::size_t index) const;
    bool isBefore(const FolderSnapshot& snapshot, std::uint32_t a, std::uint32_t b) const;

    ListOrder _order;
    Indexes _indexes; ///< the snapshot's index of each row; empty: the snapshot's own order
    std::vector<std::int64_t>
        _keys; ///< by the snapshot's indexes; empty when ordered by name, which needs none
    std::shared_ptr<const KindRanks> _kinds;
};

} // namespace screens
