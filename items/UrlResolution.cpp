// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/UrlResolution.h"

#include <algorithm>

namespace tarrow {

namespace {

platform::PromisedItems& promisedItems()
{
    return services().cloudDocumentService().promisedItems();
}

platform::DocumentContainers& containers()
{
    return services().cloudDocumentService().containers();
}

} // namespace

std::optional<Url> trw_URLByResolvingBookmark(const Url& url)
{
    if (!promisedItems().isExternalDocumentReference(url))
        return url;
    const auto target = promisedItems().resolveExternalDocumentReference(url);
    return target ? std::optional(trw_URLByResolvingPromise(*target)) : std::nullopt;
}

Url trw_URLByResolvingPromise(const Url& url)
{
    return promisedItems().isItemPromise(url) ? promisedItems().logicalURLForPromise(url) : url;
}

Url trw_URLByResolvingAlias(const Url& url)
{
    const auto target = promisedItems().resolveExternalDocumentReference(url);
    return target && !target.error ? trw_URLByResolvingPromise(*target) : url;
}

bool trw_hasPathOfSpecialFolder(const Url& url)
{
    const auto path = containers().pathRelativeToSyncedRoot(url);
    return path == "BrindleDefault/Documents" || path == "BrindleDefault/Desktop";
}

bool trw_isDesktopOrDocumentsFolder(const Url& url)
{
    // The path is compared first, because the container is looked up on the disk.
    if (!trw_hasPathOfSpecialFolder(url))
        return false;
    const auto container = containers().containerForItem(url);
    return container && *container && trw_isDesktopOrDocumentsFolderIn(**container, url);
}

bool trw_isDesktopOrDocumentsFolderIn(const DocumentContainer& container, const Url& url)
{
    return container.identifier == containers().defaultContainerIdentifier()
        && trw_hasPathOfSpecialFolder(url);
}

bool trw_canCrossZoneMoveURLs(const std::vector<Url>& urls)
{
    if (urls.empty())
        return false;
    const auto all = containers().allContainers();
    const auto source = containers().containerForItem(urls.front());
    if (!source || !*source)
        return false;
    return std::ranges::any_of(all, [&](const auto& container) {
        return container->identifier != (*source)->identifier
            && containers().canMoveWithoutDownloading(**source, *container);
    });
}

} // namespace tarrow
