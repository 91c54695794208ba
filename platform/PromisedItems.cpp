// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/PromisedItems.h"

namespace platform {

ItemReading PromisedItems::readItem(const Url& url, AttributeKeys keys) const
{
    if (auto unreachable = checkPromisedItemIsReachable(url))
        return {std::move(unreachable), {}, physicalURLForPromise(url), {}};
    return {std::nullopt, promisedItemResourceValues(url, keys), physicalURLForPromise(url),
        tagNames(url).value.value_or(std::vector<std::string>())};
}

} // namespace platform
