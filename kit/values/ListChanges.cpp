// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/ListChanges.h"

#include <algorithm>
#include <limits>
#include <unordered_map>

namespace kit {

namespace {

constexpr std::size_t nowhere = std::numeric_limits<std::size_t>::max();

/// Answers for each row of `after` its index in `before`.
std::vector<std::size_t> oldIndexes(std::span<const RowId> before, std::span<const RowId> after)
{
    std::unordered_map<RowId, std::size_t> places;
    places.reserve(before.size());
    for (std::size_t index = 0; index < before.size(); ++index)
        places.emplace(before[index], index);
    std::vector<std::size_t> old(after.size(), nowhere);
    for (std::size_t index = 0; index < after.size(); ++index) {
        if (const auto found = places.find(after[index]); found != places.end())
            old[index] = found->second;
    }
    return old;
}

/// Keeps the longest rising run of old indexes. Those rows stay where they are, and the others count as
/// moved.
void keepLongestRise(std::vector<std::size_t>& old)
{
    std::vector<std::size_t> tails; // the new index that ends the best run of each length
    std::vector<std::size_t> previous(old.size(), nowhere);
    for (std::size_t index = 0; index < old.size(); ++index) {
        if (old[index] == nowhere)
            continue;
        const auto place =
            std::ranges::lower_bound(tails, old[index], {}, [&](std::size_t tail) { return old[tail]; });
        if (place != tails.begin())
            previous[index] = *(place - 1);
        if (place == tails.end())
            tails.push_back(index);
        else
            *place = index;
    }
    std::vector<bool> stays(old.size());
    for (auto index = tails.empty() ? nowhere : tails.back(); index != nowhere; index = previous[index])
        stays[index] = true;
    for (std::size_t index = 0; index < old.size(); ++index) {
        if (!stays[index])
            old[index] = nowhere;
    }
}

/// Makes a splice reach to the end of a later one. The rows between them are removed and inserted again.
void extend(ListSplice& splice, const ListSplice& later)
{
    const auto between = later.position - (splice.position + splice.inserted);
    splice.removed += between + later.removed;
    splice.inserted += between + later.inserted;
}

} // namespace

std::vector<ListSplice> ListChanges::splicesExactWithin(const RowRange& range) const
{
    enum class Place { Before, Within, Behind };
    std::vector<ListSplice> merged;
    auto last = Place::Within;
    std::size_t removed = 0, inserted = 0; // the rows removed and inserted by the splices so far
    for (const auto& splice : splices) {
        const auto begin = splice.position + removed - inserted; // the index in the old list
        auto place = begin >= range.end() ? Place::Behind : Place::Within;
        if (begin + splice.removed <= range.first)
            place = Place::Before;
        removed += splice.removed;
        inserted += splice.inserted;
        if (place == Place::Within || place != last)
            merged.push_back(splice);
        else
            extend(merged.back(), splice);
        last = place;
    }
    return merged;
}

ListChanges ListChanges::between(std::span<const RowId> before, std::span<const RowId> after)
{
    const auto [oldEnd, newEnd] = std::ranges::mismatch(before, after);
    const auto head = static_cast<std::size_t>(oldEnd - before.begin());
    before = before.subspan(head);
    after = after.subspan(head);
    auto old = oldIndexes(before, after);
    keepLongestRise(old);
    ListChanges changes;
    std::size_t oldIndex = 0, newIndex = 0;
    while (oldIndex < before.size() || newIndex < after.size()) {
        ListSplice splice{head + newIndex, 0, 0};
        const auto start = newIndex;
        while (newIndex < after.size() && old[newIndex] == nowhere)
            ++newIndex;
        splice.inserted = newIndex - start;
        const auto next = newIndex < after.size() ? old[newIndex] : before.size();
        splice.removed = next - oldIndex;
        if (splice.removed > 0 || splice.inserted > 0)
            changes.splices.push_back(splice);
        oldIndex = next;
        if (newIndex < after.size()) {
            ++oldIndex;
            ++newIndex;
        }
    }
    return changes;
}

} // namespace kit
