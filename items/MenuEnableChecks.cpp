// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/MenuEnableChecks.h"

#include "items/DRItem.h"
#include "items/FileUtils.h"
#include "items/UrlResolution.h"
#include "platform/Dispatch.h"
#include "platform/FileSystem.h"
#include "platform/Weakly.h"
#include "screens/list/DocumentListController.h"

#include <algorithm>
#include <array>

namespace tarrow {

namespace {

namespace folderLevels = platform::folderLevels;
using Container = std::shared_ptr<const DocumentContainer>;
using platform::FileSystem;
using platform::FileType;

constexpr auto associationKey = "_TarrowDrivePlaceOfList";

/// The container of the folder that a list shows, and the number of folders between its documents folder and
/// the list's. When the container cannot be found it is null.
struct Place {
    Container container{};
    std::size_t depth = 0;
    std::optional<Error> error{};
};

Place lookUpPlace(const std::optional<Url>& url)
{
    Place place;
    std::optional<std::vector<std::string>> names;
    if (url)
        place.error = FileUtils::containerAndRelativePathforURLContainerRelativePathComponents(
            *url, &place.container, &names);
    if (place.error)
        place.container = nullptr;
    place.depth = names ? names->size() : 0;
    return place;
}

/// Answers the place of a list's folder. A line is logged when it has no container.
Place placeOf(const MenuEnableChecks::List& list, const Operation& op)
{
    const auto known = list.associatedObject<Place>(associationKey);
    const auto place = known ? *known : lookUpPlace(list.presentedURL());
    if (!place.container)
        op.error("Couldn't get container for URL %@: %@", list.presentedURL(), place.error);
    return place;
}

/// Answers whether a selection of a list holds a special folder.
bool holdsSpecialFolder(const MenuEnableChecks::List& list, const std::vector<Url>& selection)
{
    const auto known = list.associatedObject<Place>(associationKey);
    if (!known)
        return MenuEnableChecks::isDesktopOrDocumentsInURLArray(selection);
    return known->container && std::ranges::any_of(selection, [&](const Url& url) {
        return trw_isDesktopOrDocumentsFolderIn(*known->container, url);
    });
}

/// Answers whether a list may show special folders or containers, which only lie at the top of a container.
/// For other lists a selection of 100,000 items need not be searched.
bool mayShowSpecialItems(const MenuEnableChecks::List& list)
{
    const auto& url = list.presentedURL();
    return !url || services().cloudDocumentService().containers().isContainerTopFolder(*url);
}

bool isFolder(const Url& url)
{
    constexpr std::array keys{AttributeKey::IsDirectory, AttributeKey::IsPackage};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys).value;
    return values && values->flag(AttributeKey::IsDirectory) && !values->flag(AttributeKey::IsPackage);
}

/// Answers the item that an entry of a folder stands for, when that may be a visible folder.
std::optional<Url> possibleFolder(const Url& entry, FileType type)
{
    if (!entry.lastPathComponent().starts_with('.'))
        return type == FileType::Directory ? std::optional(entry) : std::nullopt;
    auto promised = trw_URLByResolvingPromise(entry);
    return promised.isSameObject(entry) ? std::nullopt : std::optional(std::move(promised));
}

bool hasFolder(const Url& documents)
{
    static constexpr Operation op{"+[MenuEnableChecks containerHasSubfolders:]"};
    bool found = false;
    services().fileSystem().enumerateShallowly(
        documents,
        [&](const Url& entry, FileType type) {
            const auto candidate = possibleFolder(entry, type);
            found = candidate && isFolder(*candidate);
            return found ? FileSystem::Continue::No : FileSystem::Continue::Yes;
        },
        [&](const Url& location, const Error& error) {
            op.info("Error enumerating %@: %@", location, error);
            return FileSystem::Continue::Yes;
        });
    return found;
}

} // namespace

void MenuEnableChecks::lookUpPlaceOf(const std::shared_ptr<List>& list, std::function<void()> done)
{
    const auto keep = [done = std::move(done)](List& self, const std::shared_ptr<Place>& place) {
        self.setAssociatedObject(associationKey, place);
        done();
    };
    auto& dispatch = services().dispatch();
    const auto queue = dispatch.makeSerialQueue("TarrowDriveAppID.places");
    // The work keeps its queue.
    queue->async(
        [queue, url = list->presentedURL(), main = dispatch.mainQueue(), weak = std::weak_ptr(list), keep] {
            main->async(platform::weakly(weak, keep, std::make_shared<Place>(lookUpPlace(url))));
        });
}

bool MenuEnableChecks::isPlaceKnown(const List& list)
{
    return list.associatedObject<Place>(associationKey) != nullptr;
}

std::size_t MenuEnableChecks::numContainersInURLArray(const std::vector<Url>& urls)
{
    const auto& containers = services().cloudDocumentService().containers();
    return static_cast<std::size_t>(
        std::ranges::count_if(urls, [&](const Url& url) { return containers.isContainerTopFolder(url); }));
}

std::size_t MenuEnableChecks::numFoldersInURLArray(const std::vector<Url>& urls)
{
    return std::ranges::any_of(urls,
               [](const Url& url) {
                   const auto item = DRItem::initWithURL(url);
                   return item && item->isDirectory();
               })
        ? 1
        : 0;
}

bool MenuEnableChecks::isDesktopOrDocumentsInURLArray(const std::vector<Url>& urls)
{
    return std::ranges::any_of(urls, trw_isDesktopOrDocumentsFolder);
}

bool MenuEnableChecks::canShowMoveForSelectedItems(const List& list)
{
    if (list.selectedItemCount() == 0)
        return false;
    const auto isSpecial = [&](const std::vector<Url>& selection) {
        return holdsSpecialFolder(list, selection) || numContainersInURLArray(selection) > 0;
    };
    if (mayShowSpecialItems(list) && isSpecial(list.selectedItems()))
        return false;
    return containerSupportsAnyDepth(list) || !list.selectionHoldsFolder();
}

bool MenuEnableChecks::canShowDeleteForSelectedItems(const List& list)
{
    if (list.selectedItemCount() == 0)
        return false;
    if (!mayShowSpecialItems(list))
        return true;
    const auto selection = list.selectedItems();
    if (holdsSpecialFolder(list, selection))
        return false;
    const auto containers = numContainersInURLArray(selection);
    return containers == 0 || containers == selection.size();
}

bool MenuEnableChecks::canEnableNewFolderForSelectedItems(const List& list)
{
    static constexpr Operation op{"+[MenuEnableChecks canEnableNewFolderForSelectedItems:]"};
    const auto [container, depth, error] = placeOf(list, op);
    if (!container)
        return false;
    const auto& [identifier, levels] = std::tie(container->identifier, container->supportedFolderLevels);
    if (!levels)
        op.debug("Container %@ has no depth. Enabling new folder button", identifier);
    else if (*levels == folderLevels::none)
        op.debug("Container %@ supports no folders. Disabling new folder button", identifier);
    else if (*levels == folderLevels::any)
        op.debug("Container %@ supports any folder. Enabling new folder button", identifier);
    else if (*levels == folderLevels::one && depth == 0)
        op.debug("Container %@ supports one folder. File is depth 0. Enabling new folder button", identifier);
    else if (*levels == folderLevels::one)
        op.debug("Container %@ supports one folder. File is depth %u. Disabling new folder button",
            identifier, depth);
    else
        op.warning(
            "Container %@ has unknown depth option %@. Disabling new folder button", identifier, *levels);
    return !levels || *levels == folderLevels::any || (*levels == folderLevels::one && depth == 0);
}

bool MenuEnableChecks::canAddItems(const List& list)
{
    static constexpr Operation op{"+[MenuEnableChecks canAddItems:]"};
    return placeOf(list, op).container != nullptr;
}

bool MenuEnableChecks::containerSupportsAnyDepth(const List& list)
{
    static constexpr Operation op{"+[MenuEnableChecks containerSupportsAnyDepth:]"};
    const auto container = placeOf(list, op).container;
    if (!container)
        return false;
    const auto& levels = container->supportedFolderLevels;
    if (!levels)
        op.debug("Container %@ has no depth. Enabling new folder button", container->identifier);
    else if (*levels == folderLevels::any)
        op.debug("Container %@ supports any folder. Enabling new folder button", container->identifier);
    return !levels || *levels == folderLevels::any;
}

bool MenuEnableChecks::containerHasSubfolders(const Url& url)
{
    Container container;
    const auto error =
        FileUtils::containerAndRelativePathforURLContainerRelativePathComponents(url, &container, nullptr);
    if (error || !container)
        return true;
    return container->documentsURL && hasFolder(*container->documentsURL);
}

} // namespace tarrow
