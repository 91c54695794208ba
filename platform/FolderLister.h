// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <vector>

namespace platform {

/// A listing under way, and then a watch over the folder. Destroying it ends both: its callback is not called
/// any more.
class FolderListing {
public:
    virtual ~FolderListing() = default;
    /// Reads the folder again.
    virtual void refresh() = 0;
};

/// Whether folders and libraries come before all documents, or among them by their names.
enum class FolderGrouping : std::uint8_t { FoldersFirst, Mixed };

/// Lists folders for the screen, off the main thread, in natural order of names in the user's language; a
/// promise shows as the item that it promises; other hidden names are left out.
class FolderLister {
public:
    using Update = std::function<void(std::shared_ptr<const FolderSnapshot>)>;

    virtual ~FolderLister() = default;

    /// Starts to list a folder, and the extra items with it. `update` is called on the main queue: perhaps
    /// once with the first rows, then with the complete list (or with the failure), and again with the
    /// complete list whenever the folder's items or their contents changed: usually a revision of the list
    /// that was delivered before. Never more than once for what one turn of the main loop brings. Main
    /// thread.
    virtual std::shared_ptr<FolderListing> list(const Url& folder,
        std::vector<FolderSnapshot::ExtraItem> extraItems, FolderGrouping grouping, Update update) = 0;
};

} // namespace platform
