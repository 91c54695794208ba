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

/// The details that a row shows beyond the listing's own. A value.
struct RowDetails {
    std::optional<std::string> name; ///< the localized name
    std::string text; ///< date and size, or date and number of items, and whether it is shared
    kit::DownloadState download = kit::DownloadState::Present;
    std::vector<std::string> tagNames;
    bool isFolderInCloud = false; ///< the folder itself is promised, which its name does not tell
    bool isContainer = false; ///< its content changes without a notice in its own folder
    std::optional<Date> modified; ///< of a downloaded document; its thumbnail shows this version

    bool operator==(const RowDetails&) const = default;
};

/// Reads the details of one item. It takes several system calls, and for a folder one pass over its names.
/// Any thread. Details that cannot be read are left out.
RowDetails readRowDetails(const Url& url, FolderEntryKind kind);

} // namespace screens
