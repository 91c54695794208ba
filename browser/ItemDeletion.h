// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace tarrow {

/// What became of a deletion.
struct DeletionOutcome {
    std::size_t failures = 0;
    std::optional<Error> lastError; ///< nothing when the failures gave none
};

/// Deletes items and app libraries, one after the other, whatever happens to each. A library goes with
/// everything in it, but for the drive's own container, which is never deleted. Blocks; main thread.
DeletionOutcome deleteItems(const std::vector<Url>& urls);

} // namespace tarrow
