// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/NameSearch.h"

#include <memory>

namespace host::system {

class MimeTypeRegistry;

/// Searches a packed index of names (see NameIndex). The index is read when the first search begins, brought
/// up to date every two seconds during a search, and dropped a minute after the last search. Bringing it up
/// to date takes one look at each folder and a reading of the modified ones.
class IndexedNameSearch : public platform::NameSearch {
public:
    IndexedNameSearch(
        std::shared_ptr<platform::Dispatch> dispatch, std::shared_ptr<const MimeTypeRegistry> types);
    ~IndexedNameSearch() override;

    std::shared_ptr<platform::NameSearchSession> begin(
        std::vector<platform::Url> folders, Update update) override;

private:
    class Store;
    class Session;

    std::shared_ptr<Store> _store;
};

} // namespace host::system
