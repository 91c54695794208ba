// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/RowIdSet.h"

#include <algorithm>
#include <bit>
#include <utility>

namespace kit {

namespace {

constexpr std::size_t fewestPlaces = 16;

// Identifiers may be plain numbers as well as hashes, so their bits are spread (by a multiplier of a
// well-known 64-bit mixer).
std::size_t spread(RowId id)
{
    id ^= id >> 32;
    id *= 0x9e3779b97f4a7c15ULL;
    return static_cast<std::size_t>(id ^ id >> 29);
}

} // namespace

std::size_t RowIdSet::place(RowId id) const
{
    const auto mask = _places.size() - 1;
    auto at = spread(id) & mask;
    while (_places[at] != emptyMark && _places[at] != id)
        at = (at + 1) & mask;
    return at;
}

bool RowIdSet::contains(RowId id) const
{
    if (id == emptyMark)
        return _hasEmptyMark;
    return !_places.empty() && _places[place(id)] == id;
}

void RowIdSet::reserve(std::size_t count)
{
    const auto wanted = std::bit_ceil(std::max(fewestPlaces, 2 * count));
    if (wanted <= _places.size())
        return;
    const auto before = std::exchange(_places, std::vector<RowId>(wanted, emptyMark));
    for (const auto id : before) {
        if (id != emptyMark)
            _places[place(id)] = id;
    }
}

void RowIdSet::insert(RowId id)
{
    if (id == emptyMark) {
        _hasEmptyMark = true;
        return;
    }
    reserve(_count + 1);
    auto& found = _places[place(id)];
    _count += found == id ? 0 : 1;
    found = id;
}

void RowIdSet::insert(std::span<const RowId> ids)
{
    reserve(_count + ids.size());
    for (const auto id : ids)
        insert(id);
}

void RowIdSet::erase(RowId id)
{
    if (id == emptyMark)
        _hasEmptyMark = false;
    if (id == emptyMark || !contains(id))
        return;
    const auto mask = _places.size() - 1;
    auto hole = place(id);
    --_count;
    // The identifiers behind the hole move up, unless one would then stand before its own place.
    for (auto next = (hole + 1) & mask; _places[next] != emptyMark; next = (next + 1) & mask) {
        const auto home = spread(_places[next]) & mask;
        if (((next - home) & mask) < ((next - hole) & mask))
            continue;
        _places[hole] = _places[next];
        hole = next;
    }
    _places[hole] = emptyMark;
}

bool RowIdSet::operator==(const RowIdSet& other) const
{
    return size() == other.size() && _hasEmptyMark == other._hasEmptyMark
        && std::ranges::all_of(_places, [&](RowId id) { return id == emptyMark || other.contains(id); });
}

} // namespace kit
