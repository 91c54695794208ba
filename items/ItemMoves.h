// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/UndoHistory.h"
#include "platform/FileChanges.h"

#include <optional>
#include <vector>

namespace tarrow {

/// An item that was moved, and what tells it from another one that takes its name later.
struct MovedItem {
    Url from, to;
    std::optional<platform::ItemVersion> version; ///< right after the move; nothing when it was gone already
    std::optional<std::uint64_t> number; ///< the document's identifier
};

/// The outcome of a change that moves items.
struct MoveOutcome {
    std::vector<MovedItem> moved;
    std::vector<Error> errors; ///< of those that could not be moved
};

/// A folder that was made, as it was when the change that made it ended.
struct MadeFolder {
    Url url;
    std::optional<platform::ItemVersion> version;
};

/// Moves an item like FileUtils::moveTo(). Neither value nor error is answered for an item that is there
/// already. Any thread; it blocks.
Result<MovedItem> moveItem(
    const Url& source, const Url& destination, const FileUtils::StillWanted& stillWanted);
/// Moves the items of a change into a folder. On the change's queue.
MoveOutcome moveItems(ItemChange& change, const Url& folder);

/// Answers the state of a folder that a change has made. On the change's queue, at its end.
MadeFolder madeFolder(const Url& folder);

/// Answers a sentence that says where an item was moved to, or what it is called now.
std::string movedSentence(const Url& from, const Url& to);

/// Answers how moves are undone; nothing without any. An item goes back only while it is the one that was
/// moved, and nothing has its old place. On the change's queue, because it asks for folders' titles.
std::optional<UndoEntry> undoOfMoves(const std::vector<MovedItem>& moved);
/// Answers how a new folder is undone into which items may have been moved: they go back, and the folder is
/// removed when nobody has changed it and nothing is left in it.
UndoEntry undoOfNewFolder(const MadeFolder& folder, const std::vector<MovedItem>& moved);

} // namespace tarrow
