// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/ThreadedFolderLister.h"

#include "host/system/listing/WatchedListing.h"
#include "platform/Dispatch.h"

namespace host::system {

ThreadedFolderLister::ThreadedFolderLister(std::shared_ptr<platform::Dispatch> dispatch,
    std::shared_ptr<const MimeTypeRegistry> types, const std::string& locale)
    : _dispatch(std::move(dispatch))
{
    _tools = std::make_shared<ListingTools>(ListingTools{EntryClassifier(std::move(types)), NameOrder(locale),
        _dispatch->makeOperationQueue("folderLister", platform::QualityOfService::UserInitiated)});
}

ThreadedFolderLister::~ThreadedFolderLister() = default;

std::shared_ptr<platform::FolderListing> ThreadedFolderLister::list(const platform::Url& folder,
    std::vector<platform::FolderSnapshot::ExtraItem> extraItems, platform::FolderGrouping grouping,
    Update update)
{
    auto listing = std::make_shared<WatchedListing>(_dispatch, _tools,
        FolderReading::Subject{folder, std::move(extraItems), grouping}, std::move(update));
    listing->refresh();
    return listing;
}

} // namespace host::system
