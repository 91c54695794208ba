// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/PropertyValue.h"

#include <cmath>
#include <limits>
#include <utility>

namespace platform {

namespace {

template <typename To>
std::optional<To> number(const PropertyValue& value)
{
    if (const auto* i = value.get<std::int64_t>())
        return std::in_range<To>(*i) ? std::optional(static_cast<To>(*i)) : std::nullopt;
    if (const auto* u = value.get<std::uint64_t>())
        return std::in_range<To>(*u) ? std::optional(static_cast<To>(*u)) : std::nullopt;
    const auto* d = value.get<double>();
    // 2^63 and 2^64 are exact as doubles; the largest integers themselves are not.
    const double limit = std::ldexp(1.0, std::numeric_limits<To>::digits);
    if (!d || *d != std::trunc(*d) || *d >= limit || *d < static_cast<double>(std::numeric_limits<To>::min()))
        return std::nullopt;
    return static_cast<To>(*d);
}

} // namespace

std::optional<std::int64_t> PropertyValue::asInteger() const
{
    return number<std::int64_t>(*this);
}

std::optional<std::uint64_t> PropertyValue::asUnsigned() const
{
    return number<std::uint64_t>(*this);
}

const PropertyValue* find(const PropertyDictionary& dictionary, std::string_view key)
{
    const auto entry = dictionary.find(key);
    return entry == dictionary.end() ? nullptr : &entry->second;
}

} // namespace platform
