// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/ListOrder.h"

namespace screens {

ListOrder ListOrder::sortedBy(OrderKey chosen) const
{
    const bool largeFirst = chosen == OrderKey::Date || chosen == OrderKey::Size;
    return {chosen, largeFirst ? OrderDirection::Descending : OrderDirection::Ascending, grouping};
}

} // namespace screens
