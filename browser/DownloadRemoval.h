// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/ItemChange.h"

#include <cstddef>
#include <vector>

namespace tarrow {

/// The outcome of removing downloads.
struct RemovedDownloads {
    std::size_t removed = 0;
    std::vector<Error> errors; ///< of documents that stay here; each has a sentence for the user
    bool isWhole = true; ///< false: it was cancelled before all documents had their turn
};

/// Removes the downloaded copies of a change's items, and of all documents in the folders among them. The
/// contents stay in the cloud. A failure does not end it. It blocks, so it runs on the change's queue.
RemovedDownloads removeDownloads(ItemChange& change);

} // namespace tarrow
