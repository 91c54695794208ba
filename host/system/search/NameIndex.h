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

/// The names of all items below some folders, packed for a search: per item its name twice (as it is, and
/// folded) and 11 bytes. Immutable; any thread.
class NameIndex {
public:
    class Builder;

    /// A folder and the items directly in it, which stand together.
    struct Folder {
        std::string path;
        std::int64_t modified = 0; ///< nanoseconds since 1970; 0: it may have changed since it was read
        std::uint32_t firstItem = 0, itemCount = 0;
    };
    struct Item {
        std::string_view name, folded;
        platform::FolderEntryKind kind;
        bool isPromise;
    };
    /// Items by number, the best ones first.
    struct Found {
        std::vector<std::uint32_t> items;
        std::size_t total = 0;
    };

    std::size_t itemCount() const { return _marks.size(); }
    const std::vector<Folder>& folders() const { return _folders; }
    Item item(std::size_t number) const;
    platform::FoundItem found(std::size_t number) const;
    std::size_t bytes() const; ///< of memory
    /// What a scan reads: the folded names, each behind a zero byte.
    std::string_view foldedNames() const { return _folded; }

    /// The items whose names hold every word of a folded text. `isCancelled` is asked now and then.
    Found find(
        std::string_view foldedQuery, std::size_t limit, const std::function<bool()>& isCancelled) const;

private:
    std::size_t itemAt(std::size_t foldedOffset, std::size_t from) const;

    std::vector<Folder> _folders; ///< in the order of their items
    std::string _names, _folded;
    std::vector<std::uint32_t> _nameEnds, _foldedEnds; ///< of each item
    std::vector<std::uint8_t> _marks; ///< kind, and whether it is a promise
};

/// Gathers an index, folder after folder.
class NameIndex::Builder {
public:
    void beginFolder(std::string path, std::int64_t modified);
    /// An item of the folder that was begun last. More than 4 GiB of names are not taken.
    void append(const Item& item);

    std::size_t itemCount() const { return _index.itemCount(); }
    /// Ends the gathering and gives back the memory that it took beyond what is needed.
    NameIndex finish();
    /// What was gathered so far.
    const NameIndex& soFar() const { return _index; }

private:
    NameIndex _index;
};

} // namespace host::system
