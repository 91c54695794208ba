// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"

#include <cstddef>
#include <span>
#include <vector>

namespace kit {

/// A set of row identifiers in one block of memory. Inserting 100,000 of them takes a millisecond or two; a
/// set of nodes takes twenty. A value.
class RowIdSet {
public:
    bool contains(RowId id) const;
    std::size_t size() const { return _count + (_hasEmptyMark ? 1 : 0); }
    bool empty() const { return size() == 0; }

    void insert(RowId id);
    void insert(std::span<const RowId> ids);
    void erase(RowId id);
    void clear() { *this = {}; }

    bool operator==(const RowIdSet& other) const;

private:
    /// Marks a place without an identifier. An identifier of this value is kept in `_hasEmptyMark`.
    static constexpr RowId emptyMark = 0;

    void reserve(std::size_t count);
    /// Answers the place where an identifier is, or where it would go.
    std::size_t place(RowId id) const;

    std::vector<RowId>
        _places; ///< the number of places is a power of two, and at most half of them are taken
    std::size_t _count = 0;
    bool _hasEmptyMark = false;
};

} // namespace kit
