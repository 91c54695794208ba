// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderLister.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <cstdint>

namespace screens {

enum class OrderKey : std::uint8_t { Name, Date, Size, Kind };
enum class OrderDirection : std::uint8_t { Ascending, Descending };

/// In which order a folder's list shows its items. A value.
struct ListOrder {
    OrderKey key = OrderKey::Name;
    OrderDirection direction = OrderDirection::Ascending;
    FolderGrouping grouping = FolderGrouping::FoldersFirst;

    /// Whether it is the order in which the lister delivers the items.
    bool isListersOwn() const { return key == OrderKey::Name && direction == OrderDirection::Ascending; }
    /// Whether each item has to be looked at for it.
    bool needsLooks() const { return key == OrderKey::Date || key == OrderKey::Size; }
    /// The order for a key that was just chosen: the newest and the largest come first, names from A.
    ListOrder sortedBy(OrderKey chosen) const;
    bool operator==(const ListOrder&) const = default;
};

/// The order that the user chose for a folder, kept between runs for the folders that were used last; else
/// the default. Main thread.
ListOrder savedOrder(const Url& folder);
void saveOrder(const Url& folder, const ListOrder& order);

} // namespace screens
