// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "platform/Url.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace platform {

/// One item that a search found.
struct FoundItem {
    Url url; ///< the item's logical location
    FolderEntryKind kind = FolderEntryKind::Document;
    bool isPromise = false; ///< only a promise of the item is here
};

/// What a search knows at one moment.
struct NameSearchResults {
    std::string query; ///< the text that was searched for, as it was given
    /// The items that were found, the best ones first: those whose names begin with the query, then those
    /// with a word that begins with it, then all others. There are at most NameSearch::shownItems.
    std::vector<FoundItem> items;
    std::size_t total = 0; ///< how many items were found, also those that `items` leaves out
    bool isComplete = false; ///< all names were searched; until then more may be found
    bool isForTag = false; ///< the query asks for items with a tag
};

/// A search that goes on while the person types. Destroying it, on the main thread, ends it; its callback is
/// not called after that.
class NameSearchSession {
public:
    virtual ~NameSearchSession() = default;
    /// Searches for another text from now on, in place of the one before; an empty text finds nothing. The
    /// call returns at once. Main thread.
    virtual void setQuery(std::string query) = 0;
};

/// Searches the names of all items below some folders, here or promised. Hidden items and what lies inside
/// packages are left out, links are not followed, and contents are never read. Every word of a query must
/// stand in the name; letter case and accents make no difference.
///
/// A query that begins with "tag:", or with that word in the user's language, finds the items with a tag that
/// begins with the rest of the query; without a rest it finds all items with tags.
class NameSearch {
public:
    /// Takes the results of the session's present query.
    using Update = std::function<void(NameSearchResults)>;

    /// The most items that one answer lists; a person who sees so many types another letter.
    static constexpr std::size_t shownItems = 200;

    virtual ~NameSearch() = default;

    /// Begins a search below some folders: their names are read in the background and read again every two
    /// seconds where something changed. `update` is called on the main queue for each query, and again when
    /// more names are known and when names changed; it is never called for a query that was replaced. A
    /// folder that cannot be read is left out. Main thread.
    virtual std::shared_ptr<NameSearchSession> begin(std::vector<Url> folders, Update update) = 0;
};

} // namespace platform
