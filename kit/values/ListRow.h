// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "kit/values/TagDots.h"
#include "platform/Image.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace kit {

/// Names a row for as long as its list lives, however the order changes.
using RowId = std::uint64_t;

enum class RowKind { Item, SectionHeader };
enum class RowAccessory { None, Disclosure };
enum class CheckState { None, Off, On };
enum class DownloadState { Present, InCloud, Downloading };

/// Everything that one row of a list shows. A value that is made when the row is about to be seen and dropped
/// afterwards.
struct ListRow {
    RowId id = 0;
    RowKind kind = RowKind::Item;
    std::optional<Image> image;
    std::string title;
    std::string detail; ///< second line; empty: none
    RowAccessory accessory = RowAccessory::None;
    /// The accessible name of a button that opens the row's menu, as a right click does; empty: no button.
    /// There is none beside a check mark.
    std::string menuName;
    CheckState check = CheckState::None; ///< the list sets it by its selection
    std::vector<TagDot> tagDots; ///< beside the title, in this order
    DownloadState download = DownloadState::Present;
    double downloadProgress = 0; ///< 0 to 1, while Downloading
    bool isDimmed = false;
    std::string accessibleDescription; ///< empty: title and detail

    bool operator==(const ListRow&) const = default;
};

} // namespace kit
