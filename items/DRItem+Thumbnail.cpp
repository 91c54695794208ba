// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/AccessScope.h"
#include "items/DRItem.h"
#include "items/FileUtils.h"

#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"

#include <algorithm>

namespace tarrow {

namespace {

/// The screens show thumbnails of this size only.
constexpr int thumbnailPixelSize = 1024;

struct ThumbnailSizes {
    const ThumbnailMap& map;
};

std::string logText(const ThumbnailSizes& sizes)
{
    std::vector<std::string> texts;
    for (const auto& [pixelSize, image] : sizes.map)
        texts.push_back(std::to_string(pixelSize) + ": " + std::to_string(image.pixelWidth()) + "x"
            + std::to_string(image.pixelHeight()));
    return platform::logText(texts);
}

} // namespace

const std::optional<Image>& DRItem::thumbnail()
{
    if (!_thumbnailFetched) {
        _thumbnailFetched = true;
        if (_resolvedURL)
            fetchThumbnail(Url(*_resolvedURL));
    }
    return _thumbnail;
}

void DRItem::fetchThumbnail(const Url& resolved)
{
    const AccessScope access(resolved);
    services().fileCoordinator().coordinateReading(
        resolved, platform::ReadingOptions::ImmediatelyAvailableMetadataOnly, [this](const Url& location) {
            updateThumbnailImage(FileUtils::getResourceValueForURL(AttributeKey::ThumbnailMap, location));
        });
}

void DRItem::updateThumbnailImage(const std::optional<AttributeValue>& thumbnailMap)
{
    static constexpr Operation op{"-[DRItem updateThumbnailImage:]"};
    const auto* map = thumbnailMap ? std::get_if<ThumbnailMap>(&*thumbnailMap) : nullptr;
    if (!map)
        return;
    op.debug("URL Thumbs: %@", ThumbnailSizes{*map});
    const auto found = std::ranges::find(*map, thumbnailPixelSize, &platform::Thumbnail::pixelSize);
    if (found != map->end())
        _thumbnail = found->image;
}

void DRItem::generateThumbnail(const std::function<void(std::optional<Image>)>& completion) const
{
    completion(std::nullopt);
}

const std::shared_ptr<platform::OperationQueue>& DRItem::getThumbnailQueue()
{
    static const auto queue =
        services().dispatch().makeOperationQueue("thumbnailQueue", platform::QualityOfService::Background);
    return queue;
}

} // namespace tarrow
