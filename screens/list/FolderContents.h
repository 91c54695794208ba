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

/// A new state of a folder's list and the way to it from the state before.
struct FolderContentsUpdate : RowsStep {
    ListingStage stage;
    std::optional<Error> error; ///< with ListingStage::Failed
};

/// Lists one folder, follows its changes and works out the exact differences, off the main thread where there
/// are many rows. Main thread only.
class FolderContents : public std::enable_shared_from_this<FolderContents> {
public:
    using Update = std::function<void(const FolderContentsUpdate&)>;

    /// Up to this many rows a difference is worked out at once (well under a millisecond).
    static constexpr std::size_t immediateRows = 2000;

    /// `update` is called on the main thread for every state, never from within `start`.
    static std::shared_ptr<FolderContents> create(Url folder, Update update);

    FolderContents(Url folder, Update update);

    /// Lists the folder, and the extra items with it, from the beginning; what is shown stays until the new
    /// list is there.
    void start(std::vector<FolderSnapshot::ExtraItem> extraItems, const ListOrder& order);

    const std::shared_ptr<const DocumentRows>& rows() const { return _rows; }

private:
    using Snapshot = std::shared_ptr<const FolderSnapshot>;
    void snapshotArrived(Snapshot snapshot);
    void wait(Snapshot snapshot);
    void workOut(Snapshot snapshot);
    void workOutInBackground(Snapshot snapshot);
    void adopt(const FolderContentsUpdate& update);

    Url _folder;
    Update _update;
    std::shared_ptr<const DocumentRows> _rows;
    ListOrder _order;
    std::shared_ptr<FolderListing> _listing;
    std::shared_ptr<OperationQueue> _queue;
    /// What arrived while a difference is worked out: the newest list, and its revisions since.
    std::deque<Snapshot> _waiting;
    bool _isWorking = false;
};

} // namespace screens
