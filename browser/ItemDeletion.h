// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/ItemChange.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace tarrow {

/// The outcome of a deletion.
struct DeletionOutcome {
    std::size_t failures = 0, deleted = 0;
    std::optional<Error> lastError; ///< absent when no failure answered an error
};

/// Deletes the items and app libraries of a change one after the other; a failure does not end it. A library
/// is deleted with everything in it. The drive's own container is never deleted. What was taken back is no
/// failure. Blocks, so it runs on the change's queue.
DeletionOutcome deleteItems(ItemChange& change);

} // namespace tarrow
