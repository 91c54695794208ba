// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/search/TagIndex.h"
#include "platform/Dispatch.h"
#include "platform/NameSearch.h"

#include <memory>
#include <string>
#include <vector>

namespace host::system {

class MimeTypeRegistry;

/// Searches a packed index of names (see NameIndex). The index is read when the first search begins, brought
/// up to date every two seconds during a search, and dropped a minute after the last search. Bringing it up
/// to date takes one look at each folder and a reading of the modified ones.
///
/// Tags are looked at only while they are searched for, all in the background, and again in the same steps: a
/// change of tags does not show in the folder. Looking at those of 100,000 items takes a few tenths of a
/// second; where it takes longer, it is done so seldom that it costs a twentieth of the time.
class IndexedNameSearch : public platform::NameSearch {
public:
    /// How tags are read, and the words that begin a query for them.
    struct Tags {
        TagIndex::Reader reader;
        std::vector<std::string> prefixes;
    };

    IndexedNameSearch(std::shared_ptr<platform::Dispatch> dispatch,
        std::shared_ptr<const MimeTypeRegistry> types, const Tags& tags);
    ~IndexedNameSearch() override;

    std::shared_ptr<platform::NameSearchSession> begin(
        std::vector<platform::Url> folders, Update update) override;

private:
    class Store;
    class Session;

    std::shared_ptr<Store> _store;
};

} // namespace host::system
