// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderLister.h"

#include <memory>
#include <string>

namespace platform {
class Dispatch;
}

namespace host::system {

class MimeTypeRegistry;
struct ListingTools;

/// Lists folders by reading only their names, on all cores, and watches them afterwards. A notice about a
/// name leads to a look at that name alone. A folder that changes without end is followed in steps, which
/// take a fifth of the time at most.
class ThreadedFolderLister : public platform::FolderLister {
public:
    /// `locale` is ICU's name of a locale, which decides the order of names.
    ThreadedFolderLister(std::shared_ptr<platform::Dispatch> dispatch,
        std::shared_ptr<const MimeTypeRegistry> types, const std::string& locale);
    ~ThreadedFolderLister() override;

    std::shared_ptr<platform::FolderListing> list(const platform::Url& folder,
        std::vector<platform::FolderSnapshot::ExtraItem> extraItems, platform::FolderGrouping grouping,
        Update update) override;

private:
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<const ListingTools> _tools;
};

} // namespace host::system
