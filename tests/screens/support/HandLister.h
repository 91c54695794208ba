// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderLister.h"

#include <memory>
#include <string>
#include <vector>

namespace testing_support {

/// A lister whose listings the test delivers by hand, so that it decides what arrives, in which order and
/// when. Like the real one it calls back on the main queue only, here from within `deliver`.
class HandLister : public platform::FolderLister {
public:
    struct Entry {
        std::string name;
        platform::FolderEntryKind kind = platform::FolderEntryKind::Document;
        bool isPromise = false;
    };
    using Entries = std::vector<Entry>;

    std::shared_ptr<platform::FolderListing> list(const platform::Url& folder,
        std::vector<platform::FolderSnapshot::ExtraItem> extraItems, platform::FolderGrouping grouping,
        Update update) override;

    /// Delivers entries to the latest listing of a folder, with its extra items first. Nothing happens when
    /// that listing has ended.
    void deliver(const platform::Url& folder, const Entries& entries,
        platform::ListingStage stage = platform::ListingStage::Complete,
        std::optional<platform::Error> error = {}) const;
    void fail(const platform::Url& folder, const platform::Error& error) const
    {
        deliver(folder, {}, platform::ListingStage::Failed, error);
    }

    /// Answers the grouping of the listing that was started last.
    platform::FolderGrouping grouping() const { return _grouping; }
    std::size_t listingsStarted() const { return _listings.size(); }

private:
    struct Listing;
    std::vector<std::weak_ptr<Listing>> _listings;
    platform::FolderGrouping _grouping = platform::FolderGrouping::FoldersFirst;
};

} // namespace testing_support
