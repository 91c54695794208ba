// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/HandLister.h"

#include <utility>

namespace testing_support {

using namespace platform;

struct HandLister::Listing : platform::FolderListing {
    Listing(Url listed, std::vector<FolderSnapshot::ExtraItem> items, Update callback)
        : folder(std::move(listed))
        , extraItems(std::move(items))
        , update(std::move(callback))
    {
    }
    void refresh() override { }

    Url folder;
    std::vector<FolderSnapshot::ExtraItem> extraItems;
    Update update;
};

std::shared_ptr<platform::FolderListing> HandLister::list(const Url& folder,
    std::vector<FolderSnapshot::ExtraItem> extraItems, platform::FolderGrouping grouping, Update update)
{
    _grouping = grouping;
    auto listing = std::make_shared<Listing>(folder, std::move(extraItems), std::move(update));
    _listings.push_back(listing);
    return listing;
}

void HandLister::deliver(
    const Url& folder, const Entries& entries, ListingStage stage, std::optional<platform::Error> error) const
{
    std::shared_ptr<Listing> latest;
    for (const auto& weak : _listings) {
        if (const auto listing = weak.lock(); listing && listing->folder == folder)
            latest = listing;
    }
    if (!latest)
        return;
    FolderSnapshot::Builder builder(folder);
    for (const auto& item : latest->extraItems)
        builder.append(item);
    for (const auto& entry : entries)
        builder.append(entry.name, entry.kind, entry.isPromise);
    latest->update(builder.finish(stage, std::move(error)));
}

} // namespace testing_support
