// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/ListingBlock.h"

#include "host/system/listing/NameOrder.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace host::system {

using platform::FolderEntry;

namespace {

/// Answers eight bytes of a key as a number with the same order. A key that ends counts as zero bytes.
std::uint64_t bigEndian(const std::vector<std::uint8_t>& keys, std::size_t begin, std::size_t length)
{
    std::uint64_t value = 0;
    for (std::size_t i = 0; i < 8; ++i)
        value = value << 8 | (i < length ? keys[begin + i] : 0);
    return value;
}

} // namespace

void ListingBlock::append(const FolderEntry& entry, std::int32_t extra)
{
    const auto name = entry.name.substr(0, std::numeric_limits<std::uint16_t>::max());
    _entries.push_back({static_cast<std::uint32_t>(_names.size()), static_cast<std::uint16_t>(name.size()),
        entry.kind, entry.isPromise, extra});
    _names.append(name);
}

FolderEntry ListingBlock::entry(std::size_t number) const
{
    const auto& entry = _entries[number];
    return {std::string_view(_names).substr(entry.nameOffset, entry.nameLength), entry.kind, entry.isPromise};
}

void ListingBlock::appendKey(const FolderEntry& entry, const NameOrder& order,
    platform::FolderGrouping grouping, std::vector<std::uint8_t>& keys)
{
    const bool isFolder = platform::opensAsFolder(entry.kind);
    // Folders come first when they are grouped, whatever their names.
    keys.push_back(isFolder && grouping == platform::FolderGrouping::FoldersFirst ? 0 : 1);
    order.appendKey(entry.name, keys);
}

bool ListingBlock::isAfter(
    const FolderEntry& other, std::span<const std::uint8_t> key, std::size_t place) const
{
    const auto& rank = _ranks[place];
    const auto own = std::span(_keys).subspan(rank.keyOffset, rank.keyLength);
    const auto order = std::lexicographical_compare_three_way(key.begin(), key.end(), own.begin(), own.end());
    return order == 0 ? other.name < entry(rank.number).name : order < 0;
}

void ListingBlock::sort(const NameOrder& order, platform::FolderGrouping grouping)
{
    _keys.reserve(_names.size() * 2 + 1024);
    _ranks.reserve(_entries.size());
    for (std::size_t number = 0; number < _entries.size(); ++number) {
        const auto begin = _keys.size();
        appendKey(entry(number), order, grouping, _keys);
        _ranks.push_back(makeRank(number, begin));
    }
    std::ranges::sort(_ranks, [this](const Rank& a, const Rank& b) { return compare(a, *this, b) < 0; });
}

ListingBlock::Rank ListingBlock::makeRank(std::size_t number, std::size_t keyOffset) const
{
    const auto length = _keys.size() - keyOffset;
    return {bigEndian(_keys, keyOffset, length), bigEndian(_keys, keyOffset + 8, length < 8 ? 0 : length - 8),
        static_cast<std::uint32_t>(number), static_cast<std::uint32_t>(keyOffset),
        static_cast<std::uint32_t>(length)};
}

std::strong_ordering ListingBlock::compare(const Rank& a, const ListingBlock& other, const Rank& b) const
{
    if (a.high != b.high)
        return a.high <=> b.high;
    if (a.low != b.low)
        return a.low <=> b.low;
    const auto common = std::min(a.keyLength, b.keyLength);
    if (const int order = std::memcmp(_keys.data() + a.keyOffset, other._keys.data() + b.keyOffset, common))
        return order <=> 0;
    if (a.keyLength != b.keyLength)
        return a.keyLength <=> b.keyLength;
    // Names that are equal in the language are ordered by their bytes, because they are still two names.
    return entry(a.number).name.compare(other.entry(b.number).name) <=> 0;
}

} // namespace host::system
