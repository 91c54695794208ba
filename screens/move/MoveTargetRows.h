// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/ListViewDataSource.h"
#include "platform/FolderSnapshot.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace screens {

class DrivePlaces;

/// The rows of a MoveTargetScreen: recent destinations under a heading of their own, then the folders of one
/// folder. Main thread only.
class MoveTargetRows : public kit::ListViewDataSource {
public:
    /// Answers whether a folder is itself to be moved and so cannot be a destination.
    using IsToBeMoved = std::function<bool(const Url&)>;
    enum class Libraries { Shown, Hidden };

    MoveTargetRows(Libraries libraries, IsToBeMoved isToBeMoved, std::shared_ptr<const DrivePlaces> places);

    void setSnapshot(std::shared_ptr<const FolderSnapshot> snapshot);
    void setRecents(std::vector<Url> recents) { _recents = std::move(recents); }

    /// Answers the folder of a row, or nothing for a heading and for a folder that is to be moved.
    std::optional<Url> destination(std::size_t index) const;
    bool isRecent(std::size_t index) const { return index > 0 && index <= _recents.size(); }
    std::vector<kit::RowId> ids() const;

    std::size_t numberOfRows(const kit::ListView& list) const override;
    kit::ListRow rowAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowId rowIdAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowKind rowKindAtIndex(const kit::ListView& list, std::size_t index) const override;

private:
    kit::RowId idAt(std::size_t index) const;
    std::size_t headRows() const { return _recents.empty() ? 0 : _recents.size() + 2; }
    kit::ListRow recentRow(std::size_t index) const;
    kit::ListRow folderRow(std::size_t index) const;

    Libraries _libraries;
    IsToBeMoved _isToBeMoved;
    std::shared_ptr<const DrivePlaces> _places;
    std::vector<Url> _recents;
    std::shared_ptr<const FolderSnapshot> _snapshot;
    std::vector<std::uint32_t> _folders; ///< indexes in the snapshot
};

} // namespace screens
