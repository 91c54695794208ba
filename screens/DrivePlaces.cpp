// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/DrivePlaces.h"

#include "platform/CloudDocumentService.h"
#include "platform/Services.h"
#include "screens/FolderPlaces.h"

namespace screens {

std::shared_ptr<const DrivePlaces> DrivePlaces::lookUp(const std::vector<Url>& folders)
{
    const auto places = std::make_shared<DrivePlaces>();
    places->_root = screens::rootFolder();
    for (const auto& container : services().cloudDocumentService().containers().allContainers()) {
        if (container->documentsURL)
            places->_documentsOfContainers.emplace(container->identifier, *container->documentsURL);
    }
    if (places->_root)
        places->_libraries = screens::extraItemsOf(*places->_root);
    for (const auto& folder : folders) {
        for (const auto& step : places->foldersDownTo(folder)) {
            auto& title = places->_titles[step.path()];
            if (title.empty())
                title = screens::folderTitle(step);
        }
    }
    return places;
}

std::vector<Url> DrivePlaces::foldersDownTo(const Url& folder) const
{
    const auto identifier = services().cloudDocumentService().containers().containerIdentifierInURL(folder);
    const auto documents =
        identifier ? _documentsOfContainers.find(*identifier) : _documentsOfContainers.end();
    if (!_root || documents == _documentsOfContainers.end())
        return {};
    return foldersBetween(*_root, documents->second, folder);
}

const std::vector<FolderSnapshot::ExtraItem>& DrivePlaces::extraItemsOf(const Url& folder) const
{
    static const std::vector<FolderSnapshot::ExtraItem> none;
    return folder == _root ? _libraries : none;
}

std::optional<std::string> DrivePlaces::folderTitle(const Url& folder) const
{
    const auto title = _titles.find(folder.path());
    return title == _titles.end() ? std::nullopt : std::optional(title->second);
}

} // namespace screens
