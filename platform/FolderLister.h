// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <vector>

namespace platform {

/// A listing under way, and then a watch over the folder. Destroying it, on the main thread, ends both; its
/// callback is not called after that.
class FolderListing {
public:
    virtual ~FolderListing() = default;
    /// Reads the whole folder again, also after a failure; the list arrives as usual. Main thread.
    virtual void refresh() = 0;
};

/// Whether folders and app libraries come before all documents, or stand among them by their names.
enum class FolderGrouping : std::uint8_t { FoldersFirst, Mixed };

/// Lists folders for the screen without blocking the main thread. A list is in the natural order of names in
/// the user's language ("file 2" before "file 10"). A promise shows as the item that it promises, unless the
/// item is there; other hidden names are left out. Nothing but names and kinds is read, so that a list costs
/// no more than its names.
class FolderLister {
public:
    /// Takes a list. The snapshot is never null and may be kept.
    using Update = std::function<void(std::shared_ptr<const FolderSnapshot>)>;

    virtual ~FolderLister() = default;

    /// Starts to list a folder, with the extra items among its own, and keeps the list up to date until the
    /// answer is destroyed. `update` is called on the main queue, never from within this call: in a large
    /// folder once with the first rows, then with the complete list, or with the failure and the rows that
    /// were read until then. It is called again with the complete list whenever the folder's items or their
    /// contents changed, usually with a revision of the list that came before. Changes come together: the
    /// first after quiet is shown within a few hundredths of a second, and while a folder changes all the
    /// time at most a fifth of the time is spent on it. A folder that cannot be opened cannot be watched
    /// either, so it is not read again by itself; refresh() tries again. Main thread.
    virtual std::shared_ptr<FolderListing> list(const Url& folder,
        std::vector<FolderSnapshot::ExtraItem> extraItems, FolderGrouping grouping, Update update) = 0;
};

} // namespace platform
