#include "screens/list/ListOrder.h"

namespace platform::components {

ListOrder ListOrder::sortedBy(OrderKey chosen) const
{
    const bool largeFirst = chosen == OrderKey::Date || chosen == OrderKey::Size;
    return {chosen, largeFirst ? OrderDirection::Descending : OrderDirection::Ascending, grouping};
}

} // namespace platform::components
