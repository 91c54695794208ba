// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/FolderPlaces.h"

#include "platform/CloudDocumentService.h"
#include "platform/Services.h"
#include "screens/DetailText.h"
#include "screens/DisplayName.h"

namespace screens {

namespace {

using Container = std::shared_ptr<const DocumentContainer>;

DocumentContainers& containers()
{
    return services().cloudDocumentService().containers();
}

bool isDefault(const DocumentContainer& container)
{
    return container.identifier == containers().defaultContainerIdentifier();
}

} // namespace

std::optional<Url> rootFolder()
{
    if (!containers().defaultContainerURL())
        return std::nullopt;
    for (const auto& container : containers().allContainers()) {
        if (isDefault(*container))
            return container->documentsURL;
    }
    return std::nullopt;
}

bool isRootFolder(const Url& folder)
{
    // The place is compared first, because the containers are looked up on the disk.
    return containers().isContainerTopFolder(folder)
        && containers().containerIdentifierInURL(folder) == containers().defaultContainerIdentifier()
        && rootFolder() == folder;
}

std::string folderTitle(const Url& folder)
{
    constexpr AttributeKey key[] = {AttributeKey::LocalizedName};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(folder, key);
    const auto* name = values ? values->get<std::string>(AttributeKey::LocalizedName) : nullptr;
    return displayName(name && !name->empty() ? *name : folder.lastPathComponent());
}

std::vector<FolderSnapshot::ExtraItem> extraItemsOf(const Url& folder)
{
    std::vector<FolderSnapshot::ExtraItem> libraries;
    if (!isRootFolder(folder))
        return libraries;
    for (const auto& container : containers().allContainers()) {
        if (!isDefault(*container) && container->documentsURL)
            libraries.push_back({*container->documentsURL, container->localizedName, FolderEntryKind::Library,
                container->iconName.value_or(std::string())});
    }
    return libraries;
}

std::vector<Url> foldersDownTo(const Url& folder)
{
    const auto root = rootFolder();
    const auto container = containers().containerForItem(folder);
    if (!root || !container || !*container || !(*container)->documentsURL)
        return {};
    return foldersBetween(*root, *(*container)->documentsURL, folder);
}

std::vector<TitledFolder> titledFoldersDownTo(const Url& folder)
{
    std::vector<TitledFolder> titled;
    for (auto& place : foldersDownTo(folder)) {
        auto title = folderTitle(place);
        titled.push_back({std::move(place), std::move(title)});
    }
    return titled;
}

std::vector<Url> foldersBetween(const Url& root, const Url& documents, const Url& folder)
{
    if (!folder.isWithin(documents))
        return {};
    std::vector<Url> folders{root};
    if (documents != root)
        folders.push_back(documents);
    auto place = documents;
    const auto names = folder.pathComponents();
    for (auto i = place.pathComponents().size(); i < names.size(); ++i) {
        place = place.appendingPathComponent(names[i], PathKind::Directory);
        folders.push_back(place);
    }
    return folders;
}

std::string placeText(const Url& item)
{
    const auto way = foldersDownTo(item.deletingLastPathComponent());
    std::string text;
    for (std::size_t i = way.size() > 1 ? 1 : 0; i < way.size(); ++i)
        text = joinedPlace(text, folderTitle(way[i]));
    return text;
}

std::vector<Url> searchableFolders()
{
    std::vector<Url> folders;
    for (const auto& container : containers().allContainers()) {
        if (container->documentsURL)
            folders.push_back(*container->documentsURL);
    }
    return folders;
}

} // namespace screens
