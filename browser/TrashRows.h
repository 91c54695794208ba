// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/TrashUtils.h"
#include "kit/values/ListRow.h"

#include <optional>
#include <string>
#include <vector>

namespace tarrow {

/// An item in the trash as the user sees it.
struct TrashRow {
    TrashedItem item;
    std::string name; ///< for the screen
    std::string place; ///< in words; empty when it is not known

    kit::RowId id() const;
    kit::ListRow listRow() const;
    /// Answers sentences that say all that is known: where it was, when it came and, unless the user moved it
    /// there, why it is in the trash.
    std::string description() const;
};

/// The content of the trash.
struct TrashContent {
    std::vector<TrashRow> rows; ///< the newest first
    std::optional<Error> error; ///< why not everything is there
};

/// Reads the trash. Any thread but the main thread, because it waits for the disk.
TrashContent readTrash();

} // namespace tarrow
