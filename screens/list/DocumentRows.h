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

/// A new state of a list's rows, and the way to it from the state before.
struct RowsStep {
    std::shared_ptr<const DocumentRows> rows;
    kit::ListChanges changes;
    /// The rows whose items may have other details now; nothing: all may.
    std::optional<std::vector<kit::RowId>> touched;
};

/// The rows that a folder list shows: the items of one snapshot in some order, with the identifiers of their
/// rows. Immutable; any thread. To make one takes a pass over all names, and what a SnapshotOrder takes.
class DocumentRows {
public:
    static std::shared_ptr<const DocumentRows> make(
        std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order = {});

    std::size_t count() const { return _ids.size(); }
    std::span<const kit::RowId> ids() const { return _ids; }
    FolderEntry entry(std::size_t row) const { return _snapshot->entry(snapshotIndex(row)); }
    Url url(std::size_t row) const { return _snapshot->url(snapshotIndex(row)); }
    /// Null for an item of the folder itself.
    const FolderSnapshot::ExtraItem* extraItem(std::size_t row) const
    {
        return _snapshot->extraItem(snapshotIndex(row));
    }
    const std::shared_ptr<const FolderSnapshot>& snapshot() const { return _snapshot; }

    /// The rows of the list's next snapshot. When it is a revision of the one before, in the same order, only
    /// what it names costs more than a copy.
    static RowsStep step(
        const DocumentRows& before, std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order);

    /// The identifier that the row of an item has, whether it is there or not.
    kit::RowId idFor(const Url& url) const;

    /// The first row at or after `from`, and then from the top, whose name begins with a text,
    /// whatever its case and accents. Main thread.
    std::optional<std::size_t> rowBeginningWith(std::string_view text, std::size_t from) const;

    /// The exact way from one state of a list to another; rows whose kind or promise changed count as
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
