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

/// The order in which a folder's list shows its items. A value.
struct ListOrder {
    OrderKey key = OrderKey::Name;
    OrderDirection direction = OrderDirection::Ascending;
    FolderGrouping grouping = FolderGrouping::FoldersFirst;

    /// Answers whether the lister delivers the items in this order.
    bool isListersOwn() const { return key == OrderKey::Name && direction == OrderDirection::Ascending; }
    /// Answers whether every item's attributes have to be read to order them.
    bool needsLooks() const { return key == OrderKey::Date || key == OrderKey::Size; }
    /// Answers the order for a key that the user just chose. Dates begin with the newest, sizes with the
    /// largest, names with A.
    ListOrder sortedBy(OrderKey chosen) const;
    bool operator==(const ListOrder&) const = default;
};

/// Answers the order that the user chose for a folder, else the default. The choices are kept between runs
/// for the folders that were used last. Main thread.
ListOrder savedOrder(const Url& folder);
void saveOrder(const Url& folder, const ListOrder& order);

} // namespace screens
