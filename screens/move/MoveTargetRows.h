// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/ListViewDataSource.h"
#include "platform/FolderSnapshot.h"

#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace platform::components {

/// The rows of a MoveTargetScreen: recent destinations under a heading of their own, then the folders of one
/// folder. Main thread only.
class MoveTargetRows : public ui::ListViewDataSource {
public:
    /// Whether a folder is to be moved itself, and so can be no destination.
    using IsToBeMoved = std::function<bool(const Url&)>;
    enum class Libraries { Shown, Hidden };

    MoveTargetRows(Libraries libraries, IsToBeMoved isToBeMoved);

    void setSnapshot(std::shared_ptr<const FolderSnapshot> snapshot);
    void setRecents(std::vector<Url> recents) { _recents = std::move(recents); }

    /// The folder of a row; nothing for a heading and for a folder that is to be moved.
    std::optional<Url> destination(std::size_t index) const;
    bool isRecent(std::size_t index) const { return index > 0 && index <= _recents.size(); }
    std::vector<ui::RowId> ids() const;

    std::size_t numberOfRows(const ui::ListView& list) const override;
    ui::ListRow rowAtIndex(const ui::ListView& list, std::size_t index) const override;
    ui::RowId rowIdAtIndex(const ui::ListView& list, std::size_t index) const override;
    ui::RowKind rowKindAtIndex(const ui::ListView& list, std::size_t index) const override;

private:
    ui::RowId idAt(std::size_t index) const;
    std::size_t headRows() const { return _recents.empty() ? 0 : _recents.size() + 2; }
    ui::ListRow recentRow(std::size_t index) const;
    ui::ListRow folderRow(std::size_t index) const;

    Libraries _libraries;
    IsToBeMoved _isToBeMoved;
    std::vector<Url> _recents;
    std::shared_ptr<const FolderSnapshot> _snapshot;
    std::vector<std::uint32_t> _folders; ///< indexes in the snapshot
};

} // namespace platform::components
