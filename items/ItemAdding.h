// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/UndoHistory.h"

#include <optional>
#include <vector>

namespace tarrow {

/// The outcome of copying items into the drive.
struct AddingOutcome {
    std::vector<Url> added; ///< the copies
    std::vector<Error> errors; ///< of the items that were not copied, each with a sentence
    std::optional<UndoEntry> undo; ///< moves the copies to the trash; nothing when there are none
};

/// Says whether folders may be copied into a place, too.
enum class Accepts { Everything, FilesOnly };

/// Copies the items of a change, which lie anywhere on this machine, into a folder of the drive. A copy whose
/// name is taken gets that of a further copy. On the change's queue.
AddingOutcome addItems(ItemChange& change, const Url& folder, Accepts accepts);

} // namespace tarrow
