// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/NameOrder.h"

#include <unicode/coll.h>
#include <unicode/ustring.h>

#include <algorithm>
#include <array>

namespace host::system {

namespace {

// A name has at most 255 bytes on disk. A library's name may be longer and is cut here for sorting only.
constexpr std::size_t maximumUnits = 512;
// Keys of usual names are much shorter.
constexpr std::size_t usualKey = 512;

using Units = std::array<UChar, maximumUnits>;

/// Converts the name to UTF-16 and answers its length.
std::int32_t widen(std::string_view name, Units& units)
{
    name = name.substr(0, maximumUnits);
    const bool isAscii =
        std::ranges::all_of(name, [](char c) { return static_cast<unsigned char>(c) < 0x80; });
    if (isAscii) {
        std::ranges::copy(name, units.begin());
        return static_cast<std::int32_t>(name.size());
    }
    std::int32_t length = 0;
    UErrorCode status = U_ZERO_ERROR;
    u_strFromUTF8WithSub(units.data(), maximumUnits, &length, name.data(),
        static_cast<std::int32_t>(name.size()), 0xfffd, nullptr, &status);
    return U_SUCCESS(status) ? length : 0;
}

} // namespace

struct NameOrder::Data {
    std::unique_ptr<icu::Collator> collator;
};

NameOrder::NameOrder(const std::string& locale)
    : _data(std::make_unique<Data>())
{
    UErrorCode status = U_ZERO_ERROR;
    _data->collator.reset(icu::Collator::createInstance(icu::Locale(locale.c_str()), status));
    if (!_data->collator)
        return;
    _data->collator->setAttribute(UCOL_NUMERIC_COLLATION, UCOL_ON, status);
    // Blanks and punctuation count, because otherwise "a b" and "ab" would be equal and their order random.
    _data->collator->setAttribute(UCOL_ALTERNATE_HANDLING, UCOL_NON_IGNORABLE, status);
}

NameOrder::NameOrder(NameOrder&&) noexcept = default;
NameOrder::~NameOrder() = default;

void NameOrder::appendKey(std::string_view name, std::vector<std::uint8_t>& keys) const
{
    const auto begin = keys.size();
    if (!_data->collator) {
        keys.insert(keys.end(), name.begin(), name.end());
        return;
    }
    Units units;
    const auto length = widen(name, units);
    keys.resize(begin + usualKey);
    auto size = _data->collator->getSortKey(units.data(), length, keys.data() + begin, usualKey);
    if (static_cast<std::size_t>(size) > usualKey) {
        keys.resize(begin + static_cast<std::size_t>(size));
        size = _data->collator->getSortKey(units.data(), length, keys.data() + begin, size);
    }
    keys.resize(begin + static_cast<std::size_t>(size));
}

} // namespace host::system
