// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"
#include "platform/Date.h"
#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <optional>
#include <string>
#include <vector>

namespace screens {

/// What a row shows beyond what the listing knows. A value.
struct RowDetails {
    std::optional<std::string> name; ///< the localized name
    std::string text; ///< date and size, or date and number of items, and whether it is shared
    kit::DownloadState download = kit::DownloadState::Present;
    std::vector<std::string> tagNames;
    bool isContainer = false; ///< what it holds changes without a notice in its own folder
    std::optional<Date> modified; ///< a document that is here: its thumbnail is of this version

    bool operator==(const RowDetails&) const = default;
};

/// Asks for the details of one item. Several system calls, and for a folder one pass over its names; any
/// thread. What cannot be read is left out.
RowDetails readRowDetails(const Url& url, FolderEntryKind kind);

} // namespace screens
