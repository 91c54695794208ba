// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListChanges.h"
#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/list/SnapshotOrder.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

namespace screens {

class DocumentRows;

/// A new state of a list's rows, and the difference from the state before.
struct RowsStep {
    std::shared_ptr<const DocumentRows> rows;
    kit::ListChanges changes;
    /// The rows whose items may have other details now; absent when all may have.
    std::optional<std::vector<kit::RowId>> touched;
};

/// The rows that a folder list shows: the items of one snapshot in some order, with the identifiers of their
/// rows. Immutable; any thread. Making one passes over all names once and makes a SnapshotOrder.
class DocumentRows {
public:
    static std::shared_ptr<const DocumentRows> make(
        std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order = {});

    std::size_t count() const { return _ids.size(); }
    std::span<const kit::RowId> ids() const { return _ids; }
    FolderEntry entry(std::size_t row) const { return _snapshot->entry(snapshotIndex(row)); }
    Url url(std::size_t row) const { return _snapshot->url(snapshotIndex(row)); }
    /// Answers null for an item of the folder itself.
    const FolderSnapshot::ExtraItem* extraItem(std::size_t row) const
    {
        return _snapshot->extraItem(snapshotIndex(row));
    }
    const std::shared_ptr<const FolderSnapshot>& snapshot() const { return _snapshot; }

    /// Answers the rows of the list's next snapshot. When it is a revision of the one before, in the same
    /// order, the cost is a copy and the work for the items that the revision names.
    static RowsStep step(
        const DocumentRows& before, std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order);

    /// Answers the identifier that the row of an item has or would have.
    kit::RowId idFor(const Url& url) const;
    /// Answers the same for an item that lies elsewhere, as the results of a search do.
    static kit::RowId idForExtraItem(const Url& url);

    /// Answers the first row at or after `from`, and then from the top, whose name begins with a text
    /// regardless of case and accents. Main thread.
    std::optional<std::size_t> rowBeginningWith(std::string_view text, std::size_t from) const;

    /// Answers the exact difference between two states of a list. Rows whose kind or promise changed count as
    /// changed.
    static kit::ListChanges changes(const DocumentRows& before, const DocumentRows& after);

private:
    DocumentRows(std::shared_ptr<const FolderSnapshot> snapshot, SnapshotOrder order);
    static std::optional<RowsStep> revised(
        const DocumentRows& before, const std::shared_ptr<const FolderSnapshot>& snapshot);
    std::size_t snapshotIndex(std::size_t row) const { return _order.index(row); }
    kit::RowId idAt(std::size_t row) const;

    std::shared_ptr<const FolderSnapshot> _snapshot;
    SnapshotOrder _order;
    std::vector<kit::RowId> _ids;
};

} // namespace screens
