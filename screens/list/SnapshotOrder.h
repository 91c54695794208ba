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

/// The places of a snapshot's entries in an order; equal ones stay in the order of their names. A value. To
/// make one looks at each item where the order needs that: off the main thread then.
class SnapshotOrder {
public:
    using Indexes = std::vector<std::uint32_t>;
    /// What a revision does to the rows: which go, of those before; which come and which may show something
    /// else, of those after. All rise.
    struct Step {
        Indexes removed, inserted, touched;
    };

    SnapshotOrder(const FolderSnapshot& snapshot, const ListOrder& order);

    const ListOrder& order() const { return _order; }
    /// The entry of the snapshot that stands in a row.
    std::size_t index(std::size_t row) const { return _indexes.empty() ? row : _indexes[row]; }

    /// The same order of a revision of the snapshot, for which only what it names is looked at. Nothing when
    /// it can only be made anew.
    std::optional<SnapshotOrder> revised(const FolderSnapshot& after, Step& step) const;

private:
    class Merge;
    SnapshotOrder() = default;
    std::optional<std::int64_t> keyOf(const FolderSnapshot& snapshot, std::size_t index) const;
    bool isBefore(const FolderSnapshot& snapshot, std::uint32_t a, std::uint32_t b) const;

    ListOrder _order;
    Indexes _indexes; ///< of the rows' entries; empty: the snapshot's own order
    std::vector<std::int64_t> _keys; ///< by the snapshot's indexes; empty: names, which need none
    std::shared_ptr<const KindRanks> _kinds;
};

} // namespace screens
