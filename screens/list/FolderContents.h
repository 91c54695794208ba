// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/FolderLister.h"
#include "screens/PlatformNames.h"
#include "screens/list/DocumentRows.h"

#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace screens {

/// A new state of a folder's list, and the difference from the state before.
struct FolderContentsUpdate : RowsStep {
    ListingStage stage;
    std::optional<Error> error; ///< set with ListingStage::Failed
};

/// Lists one folder, follows its changes and computes the exact differences. Differences of many rows are
/// computed off the main thread. Main thread only.
class FolderContents : public std::enable_shared_from_this<FolderContents> {
public:
    using Update = std::function<void(const FolderContentsUpdate&)>;

    /// Differences of up to so many rows are computed at once, which takes well under a millisecond.
    static constexpr std::size_t immediateRows = 2000;

    /// `update` is called on the main thread for every new state, never from within `start`.
    static std::shared_ptr<FolderContents> create(Url folder, Update update);

    FolderContents(Url folder, Update update);

    /// Lists the folder with the extra items from the beginning. The old list stays on the screen until the
    /// new one is there.
    void start(std::vector<FolderSnapshot::ExtraItem> extraItems, const ListOrder& order);

    const std::shared_ptr<const DocumentRows>& rows() const { return _rows; }

private:
    using Snapshot = std::shared_ptr<const FolderSnapshot>;
    void snapshotArrived(Snapshot snapshot);
    void wait(Snapshot snapshot);
    void workOut(const Snapshot& snapshot);
    void workOutInBackground(const Snapshot& snapshot);
    void workEnded(const FolderContentsUpdate& update);
    void adopt(const FolderContentsUpdate& update);

    Url _folder;
    Update _update;
    std::shared_ptr<const DocumentRows> _rows;
    ListOrder _order;
    std::shared_ptr<FolderListing> _listing;
    std::shared_ptr<OperationQueue> _queue;
    /// The snapshots that arrived while a difference is computed: the newest whole list and its later
    /// revisions.
    std::deque<Snapshot> _waiting;
    bool _isWorking = false;
};

} // namespace screens
