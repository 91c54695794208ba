// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"

#include "platform/Localization.h"

#include <algorithm>

namespace tarrow {

namespace {

using Components = std::optional<std::vector<std::string>>;

constexpr std::string_view rightToLeftMark = "\u200f";

const platform::DocumentContainers& containers()
{
    return services().cloudDocumentService().containers();
}

/// Answers how many names a location has below the root of all cloud documents.
std::optional<std::size_t> depth(const std::optional<Url>& url)
{
    const auto path = url ? containers().pathRelativeToSyncedRoot(*url) : std::nullopt;
    if (!path)
        return std::nullopt;
    return path->empty() ? 0 : static_cast<std::size_t>(std::ranges::count(*path, '/')) + 1;
}

std::string shownName(const Url& url)
{
    static constexpr Operation op{
        "+[FileUtils containerAndRelativePathforURL:container:relativePathComponents:]"};
    const AttributeKey keys[] = {AttributeKey::LocalizedName};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    if (const auto* name = values ? values->get<std::string>(AttributeKey::LocalizedName) : nullptr)
        return *name;
    op.debug("Can't get localizedName for URL %@: err %@", url, values.error);
    return url.lastPathComponent();
}

std::optional<Error> splitPath(const Url& url, const DocumentContainer& container, Components& components)
{
    const auto itemDepth = depth(url), folderDepth = depth(container.documentsURL);
    if (!itemDepth || !folderDepth || *itemDepth < *folderDepth)
        return Error(FileErrorCode::Formatting);
    if (*itemDepth == *folderDepth)
        return std::nullopt;
    std::optional<Error> error;
    std::vector<std::string> names;
    for (auto [current, left] = std::pair(url, *itemDepth - *folderDepth); left > 0; --left) {
        auto name = shownName(current);
        if (name.empty()) {
            error = Error(FileErrorCode::Formatting);
            break;
        }
        names.push_back(std::move(name));
        current = current.deletingLastPathComponent();
    }
    std::ranges::reverse(names);
    components = std::move(names);
    return error;
}

/// Isolates the writing direction of a name, so that it does not affect the line around it.
std::string isolated(const std::string& name)
{
    return platform::formatText("\u2068%@\u2069", {name});
}

} // namespace

std::string_view FileUtils::pathBarArrowCharacter(bool rightToLeft)
{
    return rightToLeft ? " ◂ " : " ▸ ";
}

std::optional<Error> FileUtils::containerAndRelativePathforURLContainerRelativePathComponents(
    const Url& url, std::shared_ptr<const DocumentContainer>* container, Components* relativePathComponents)
{
    static constexpr Operation op{
        "+[FileUtils containerAndRelativePathforURL:container:relativePathComponents:]"};
    const auto lookup = containers().containerForItem(url);
    auto found = lookup.value.value_or(nullptr);
    if (!found || lookup.error) {
        const auto identifier = containers().containerIdentifierInURL(url);
        found = identifier ? containers().containerWithIdentifier(*identifier) : nullptr;
    }
    if (!found) {
        op.warning(
            "Split URL: %@", lookup.error ? std::optional(lookup.error->debugDescription()) : std::nullopt);
        return lookup.error;
    }
    if (container)
        *container = found;
    if (!relativePathComponents)
        return lookup.error;
    const auto error = splitPath(url, *found, *relativePathComponents);
    return lookup.error ? lookup.error : error;
}

std::optional<std::string> FileUtils::displayableLocationForURL(const Url& url)
{
    std::shared_ptr<const DocumentContainer> container;
    Components components;
    if (containerAndRelativePathforURLContainerRelativePathComponents(url, &container, &components)
        || !container)
        return std::nullopt;
    const auto defaultIdentifier = containers().defaultContainerIdentifier();
    const auto drive = containers().containerWithIdentifier(defaultIdentifier);
    const bool rightToLeft = services().localization().isRightToLeft();
    const auto arrow = pathBarArrowCharacter(rightToLeft);
    std::string line;
    if (rightToLeft)
        line += rightToLeftMark;
    line += isolated(drive ? drive->localizedName : std::string());
    if (container->identifier != defaultIdentifier)
        line.append(arrow).append(isolated(container->localizedName));
    for (std::size_t i = 0; components && i + 1 < components->size(); ++i)
        line.append(arrow).append(isolated((*components)[i]));
    return line;
}

} // namespace tarrow
