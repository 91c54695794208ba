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

/// One item whose name was searched for.
struct FoundItem {
    Url url; ///< the logical location
    FolderEntryKind kind = FolderEntryKind::Document;
    bool isPromise = false;
};

struct NameSearchResults {
    std::string query; ///< what was searched for
    /// The best ones first: names that begin with the query, then those with a word that does, then the
    /// others; at most NameSearch::shownItems.
    std::vector<FoundItem> items;
    std::size_t total = 0; ///< all items that were found
    bool isComplete = false; ///< all names are known; until then there may be more
};

/// A search that goes on while the person types. Destroying it ends it: its callback is not called any more.
class NameSearchSession {
public:
    virtual ~NameSearchSession() = default;
    /// Searches for another text from now on; an empty one finds nothing. Main thread.
    virtual void setQuery(std::string query) = 0;
};

/// Searches the names of all items below some folders, packages' contents and hidden items left out. Every
/// word of a query must stand in the name; case and accents make no difference.
class NameSearch {
public:
    using Update = std::function<void(NameSearchResults)>;

    static constexpr std::size_t shownItems = 200;

    virtual ~NameSearch() = default;

    /// Begins to learn the names below the folders, and follows their changes within a few seconds. `update`
    /// is called on the main queue for each query, again when more names are known and when the results may
    /// have changed, never for a query that was replaced. Main thread.
    virtual std::shared_ptr<NameSearchSession> begin(std::vector<Url> folders, Update update) = 0;
};

} // namespace platform
