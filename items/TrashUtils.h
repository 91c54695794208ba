// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/UndoHistory.h"
#include "platform/Trash.h"

#include <optional>
#include <vector>

namespace tarrow {

using platform::TrashedItem;

/// Moves items into the drive's trash and back, each in a coordinated write. Any thread; an operation blocks
/// until other readers and writers in any process have let it, and waits for the disk. Errors have a sentence
/// for the user.
class TrashUtils {
public:
    TrashUtils() = delete;
    using StillWanted = FileUtils::StillWanted;

    /// What is in the trash stays there for so many days.
    static constexpr int daysInTrash = 30;

    /// Moves an item into the trash. If it changed after this was called, it stays and
    /// FileErrorCode::Cancelled is answered.
    static Result<TrashedItem> moveToTrash(const Url& url, const StillWanted& stillWanted = {});
    /// Moves an item back to its place, or to the drive's top level when that is not known. Answers its
    /// location, or FileErrorCode::ItemExists when the place is taken.
    static Result<Url> restore(const TrashedItem& item, const StillWanted& stillWanted = {});
    /// Moves an item back beside what has its place now, as a copy of that would be named.
    static Result<Url> restoreBeside(const TrashedItem& item, const StillWanted& stillWanted = {});
    /// Answers the location to which restore() moves an item.
    static Url placeOf(const TrashedItem& item);
    /// Removes what has been in the trash for longer than daysInTrash.
    static void removeOld();
};

/// The outcome of moving items to the trash.
struct TrashingOutcome {
    std::vector<Error> errors; ///< of those that stay where they are, each with a sentence
    std::optional<UndoEntry> undo; ///< nothing when none was moved
};
/// Moves the items of a change to the trash. On the change's queue.
TrashingOutcome moveItemsToTrash(ItemChange& change);

/// The outcome of moving items back from the trash.
struct RestoringOutcome {
    std::vector<Url> restored; ///< where they are now
    std::vector<TrashedItem> refused; ///< their places are taken
    std::vector<Error> errors; ///< of the others
};
enum class IfTaken { Refuse, KeepBoth };
/// Moves items back; they are those of the change, which has their places. On the change's queue.
RestoringOutcome restoreItems(ItemChange& change, const std::vector<TrashedItem>& items, IfTaken ifTaken);
/// Removes items from the trash for good, and answers the errors of those that could not be removed. On the
/// change's queue.
std::vector<Error> removeItemsForGood(ItemChange& change, const std::vector<TrashedItem>& items);
/// Answers the places of items, for a change that works on them.
std::vector<Url> placesOf(const std::vector<TrashedItem>& items);

} // namespace tarrow
