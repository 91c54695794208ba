// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "platform/NameSearch.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace host::system {

/// The names of all items below some folders, packed for a search. Each item takes its name twice (as it is,
/// and folded) and 11 bytes. Immutable; any thread.
class NameIndex {
public:
    class Builder;

    /// A folder and the items directly in it, which follow one another.
    struct Folder {
        std::string path;
        std::int64_t modified =
            0; ///< nanoseconds since 1970; 0: the folder may have changed since it was read
        std::uint32_t firstItem = 0, itemCount = 0;
    };
    struct Item {
        std::string_view name, folded;
        platform::FolderEntryKind kind;
        bool isPromise;
    };
    /// The numbers of items, the best ones first.
    struct Found {
        std::vector<std::uint32_t> items;
        std::size_t total = 0;
    };

    std::size_t itemCount() const { return _marks.size(); }
    const std::vector<Folder>& folders() const { return _folders; }
    Item item(std::size_t number) const;
    platform::FoundItem found(std::size_t number) const;
    std::size_t bytes() const; ///< of memory
    /// Answers the text that a scan reads: the folded names, each behind a zero byte.
    std::string_view foldedNames() const { return _folded; }

    /// Answers the items whose names contain every word of a folded text. `isCancelled` is asked every few
    /// thousand hits.
    Found find(
        std::string_view foldedQuery, std::size_t limit, const std::function<bool()>& isCancelled) const;

private:
    std::size_t itemAt(std::size_t foldedOffset, std::size_t from) const;

    std::vector<Folder> _folders; ///< in the order of their items
    std::string _names, _folded;
    std::vector<std::uint32_t> _nameEnds, _foldedEnds; ///< of each item
    std::vector<std::uint8_t> _marks; ///< kind and promise flag of each item
};

/// Builds an index, folder after folder.
class NameIndex::Builder {
public:
    void beginFolder(std::string path, std::int64_t modified);
    /// Adds an item to the folder that was begun last. Names beyond 4 GiB are left out.
    void append(const Item& item);

    std::size_t itemCount() const { return _index.itemCount(); }
    /// Answers the index and releases the memory that it does not need.
    NameIndex finish();
    /// Answers the index so far.
    const NameIndex& soFar() const { return _index; }

private:
    NameIndex _index;
};

} // namespace host::system
