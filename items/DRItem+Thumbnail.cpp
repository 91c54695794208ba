// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/AccessScope.h"
#include "items/DRItem.h"
#include "items/FileUtils.h"

#include "platform/Dispatch.h"
#include "platform/FileCoordinator.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <deque>
#include <utility>

namespace tarrow {

using platform::weakly;

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

std::optional<AttributeValue> readThumbnails(const Url& resolved)
{
    std::optional<AttributeValue> thumbnails;
    const AccessScope access(resolved);
    services().fileCoordinator().coordinateReading(
        resolved, platform::ReadingOptions::ImmediatelyAvailableMetadataOnly, [&](const Url& location) {
            thumbnails = FileUtils::getResourceValueForURL(AttributeKey::ThumbnailMap, location);
        });
    return thumbnails;
}

/// The thumbnails that were found last, so that a document that is read again shows its own at once. Main
/// thread.
class RecentThumbnails {
public:
    std::optional<Image> find(const Url& url, const std::optional<Date>& modified) const
    {
        const auto found = std::ranges::find_if(
            _kept, [&](const Kept& kept) { return kept.path == url.path() && kept.modified == modified; });
        return modified && found != _kept.end() ? std::optional(found->image) : std::nullopt;
    }
    void keep(const Url& url, const std::optional<Date>& modified, const Image& image)
    {
        std::erase_if(_kept, [&](const Kept& kept) { return kept.path == url.path(); });
        _kept.push_front({url.path(), modified, image});
        if (_kept.size() > mostKept)
            _kept.pop_back();
    }

private:
    static constexpr std::size_t mostKept = 4; ///< one takes up to 4 MiB
    struct Kept {
        std::string path;
        std::optional<Date> modified;
        Image image;
    };
    std::deque<Kept> _kept;
};

RecentThumbnails& recentThumbnails()
{
    static RecentThumbnails recent;
    return recent;
}

} // namespace

/// A fetch of a record's thumbnail. Its queue ends with it, so that a fetch that nobody wants any more does
/// not begin.
struct DRItem::ThumbnailFetch {
    std::shared_ptr<platform::OperationQueue> queue;
    std::vector<std::function<void()>> waiting;
};

const std::optional<Image>& DRItem::thumbnail()
{
    if (!_thumbnailFetched) {
        _thumbnailFetched = true;
        if (_resolvedURL)
            fetchThumbnail();
    }
    return _thumbnail;
}

void DRItem::whenThumbnailArrives(std::function<void()> arrived)
{
    if (_thumbnailFetch)
        _thumbnailFetch->waiting.push_back(std::move(arrived));
}

void DRItem::fetchThumbnail()
{
    _thumbnail = recentThumbnails().find(*_resolvedURL, _contentModificationDate);
    if (_thumbnail)
        return;
    auto& dispatch = services().dispatch();
    _thumbnailFetch = std::make_shared<ThumbnailFetch>();
    _thumbnailFetch->queue =
        dispatch.makeOperationQueue("item thumbnail", platform::QualityOfService::Utility);
    _thumbnailFetch->queue->addOperation(
        [resolved = *_resolvedURL, main = dispatch.mainQueue(),
            wereRead = weakly(this, &DRItem::thumbnailsWereRead, std::weak_ptr(_thumbnailFetch))] {
            main->async([wereRead, thumbnails = readThumbnails(resolved)] { wereRead(thumbnails); });
        });
}

void DRItem::thumbnailsWereRead(
    const std::weak_ptr<ThumbnailFetch>& fetch, const std::optional<AttributeValue>& thumbnailMap)
{
    const auto ended = fetch.lock();
    if (!ended || ended != _thumbnailFetch)
        return;
    _thumbnailFetch.reset();
    updateThumbnailImage(thumbnailMap);
    if (!_thumbnail)
        return;
    recentThumbnails().keep(*_resolvedURL, _contentModificationDate, *_thumbnail);
    for (const auto& arrived : ended->waiting)
        arrived();
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
