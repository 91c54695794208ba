// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/ItemContents.h"

#include "platform/FileSystem.h"
#include "platform/PromisedItems.h"

#include <array>

namespace tarrow {

using platform::FileSystem;
using platform::FileType;

namespace {

constexpr std::array lookedUp{AttributeKey::IsDirectory, AttributeKey::IsRegularFile, AttributeKey::IsPackage,
    AttributeKey::DownloadingStatus};

platform::PromisedItems& promisedItems()
{
    return services().cloudDocumentService().promisedItems();
}

/// Goes through items and folders, and keeps the documents whose content is in a place.
class Search {
public:
    Search(ContentPlace place, const FileUtils::StillWanted& stillWanted)
        : _place(place)
        , _stillWanted(stillWanted)
    {
    }

    void lookAt(const Url& item)
    {
        const auto read = promisedItems().promisedItemResourceValues(item, lookedUp);
        if (!read) {
            if (read.error)
                _found.errors.push_back(*read.error);
            return;
        }
        const auto& values = *read;
        const auto* status = values.get<platform::DownloadingStatus>(AttributeKey::DownloadingStatus);
        if (status && *status == platform::DownloadingStatus::NotDownloaded)
            keep(item, ContentPlace::Cloud);
        else if (values.flag(AttributeKey::IsPackage) && _place == ContentPlace::Here)
            keep(item, ContentPlace::Here);
        else if (values.flag(AttributeKey::IsDirectory))
            _folders.push_back(item);
        else if (values.flag(AttributeKey::IsRegularFile))
            keepFile(item);
    }

    FoundDocuments finish()
    {
        while (!_folders.empty() && _stillWanted()) {
            const auto folder = std::move(_folders.back());
            _folders.pop_back();
            readFolder(folder);
        }
        return std::move(_found);
    }

private:
    void readFolder(const Url& folder)
    {
        std::vector<Url> subfolders;
        services().fileSystem().enumerateShallowly(
            folder,
            [&](const Url& entry, FileType type) {
                if (type == FileType::Directory)
                    subfolders.push_back(entry);
                else if (type == FileType::Regular)
                    lookAtFile(entry);
                return FileSystem::Continue::Yes;
            },
            [&](const Url&, const Error& error) {
                _found.errors.push_back(error);
                return FileSystem::Continue::Yes;
            });
        for (const auto& subfolder : subfolders) {
            if (!isHidden(subfolder))
                lookAt(subfolder);
        }
    }

    void lookAtFile(const Url& file)
    {
        if (!isHidden(file))
            return keepFile(file);
        if (_place != ContentPlace::Cloud || !promisedItems().isItemPromise(file))
            return;
        // A document beside its own promise counts, and the promise does not.
        const auto promised = promisedItems().logicalURLForPromise(file);
        if (!FileUtils::exists(promised))
            keep(promised, ContentPlace::Cloud);
    }

    void keepFile(const Url& file)
    {
        // A reference must be readable, or nobody knows what it stands for.
        if (_place == ContentPlace::Here && !promisedItems().isExternalDocumentReference(file))
            keep(file, ContentPlace::Here);
    }

    void keep(const Url& document, ContentPlace place)
    {
        if (place == _place)
            _found.documents.push_back(document);
    }

    static bool isHidden(const Url& url) { return url.lastPathComponent().starts_with('.'); }

    const ContentPlace _place;
    const FileUtils::StillWanted& _stillWanted;
    std::vector<Url> _folders; ///< to be read
    FoundDocuments _found;
};

} // namespace

FoundDocuments findDocuments(
    const std::vector<Url>& items, ContentPlace place, const FileUtils::StillWanted& stillWanted)
{
    Search search(place, stillWanted);
    for (const auto& item : items)
        search.lookAt(item);
    return search.finish();
}

} // namespace tarrow
