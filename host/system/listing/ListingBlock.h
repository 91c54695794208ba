// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderLister.h"

#include <compare>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace host::system {

class NameOrder;

/// A part of a folder's entries. One thread gathers them, then the block is sorted by itself and merged with
/// the others.
class ListingBlock {
public:
    /// Packs an entry and copies its name. `extra` is the index of its extra item, or -1.
    void append(const platform::FolderEntry& entry, std::int32_t extra = -1);
    std::size_t count() const { return _entries.size(); }
    std::size_t nameBytes() const { return _names.size(); }

    /// Appends the key by which entries of a list are compared before their names as bytes.
    static void appendKey(const platform::FolderEntry& entry, const NameOrder& order,
        platform::FolderGrouping grouping, std::vector<std::uint8_t>& keys);
    /// Sorts the block. Entries keep their numbers, and numberAt() answers them by place.
    void sort(const NameOrder& order, platform::FolderGrouping grouping);

    /// Answers the entry at a number. Its name lives as long as the block, once nothing more is appended.
    platform::FolderEntry entry(std::size_t number) const;
    std::int32_t extra(std::size_t number) const { return _entries[number].extra; }

    /// Answers the number of the entry at a place of the sorted block.
    std::size_t numberAt(std::size_t place) const { return _ranks[place].number; }
    /// Answers whether the entry at a place comes before the one at a place of another block.
    bool isBefore(std::size_t place, const ListingBlock& other, std::size_t otherPlace) const
    {
        return compare(_ranks[place], other, other._ranks[otherPlace]) < 0;
    }
    /// Answers whether an entry of a list, by its key, comes before the one at a place.
    bool isAfter(
        const platform::FolderEntry& other, std::span<const std::uint8_t> key, std::size_t place) const;

private:
    struct Entry {
        std::uint32_t nameOffset;
        std::uint16_t nameLength;
        platform::FolderEntryKind kind;
        bool isPromise;
        std::int32_t extra;
    };
    /// Enough bytes of an entry's sort key to compare nearly all entries without the key itself.
    struct Rank {
        std::uint64_t high, low;
        std::uint32_t number;
        std::uint32_t keyOffset;
        std::uint32_t keyLength;
    };
    Rank makeRank(std::size_t number, std::size_t keyOffset) const;
    std::strong_ordering compare(const Rank& a, const ListingBlock& other, const Rank& b) const;

    std::string _names;
    std::vector<Entry> _entries;
    std::vector<std::uint8_t> _keys;
    std::vector<Rank> _ranks;
};

} // namespace host::system
