// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/ThumbnailCache.h"

#include "host/drive/service/ThumbnailFiles.h"
#include "platform/ImageLoader.h"
#include "platform/PagedDocument.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <utility>

namespace host::drive {

namespace {

using platform::Error;
using platform::Image;
using platform::Result;
using platform::ThumbnailContent;
using platform::ThumbnailMap;
using system::Pixbuf;

std::optional<Image> imageOf(const Pixbuf& picture)
{
    return picture ? std::optional(system::imageOf(picture.get(), 1)) : std::nullopt;
}

Error imageError(platform::ImageErrorCode code)
{
    return {platform::errorDomain::image, static_cast<int>(code)};
}

/// Answers whether the error will come again as long as the document does not change.
bool isLasting(const Error& error)
{
    return error.domain() == platform::errorDomain::image || error.domain() == platform::errorDomain::pages;
}

Result<Image> scaledPicture(const std::string& path)
{
    if (::access(path.c_str(), R_OK) != 0)
        return Error(platform::errorDomain::system, errno);
    int width = 0, height = 0;
    if (!gdk_pixbuf_get_file_info(path.c_str(), &width, &height) || width <= 0 || height <= 0)
        return imageError(platform::ImageErrorCode::Damaged);
    if (std::int64_t{width} * height > ThumbnailCache::mostPixels)
        return imageError(platform::ImageErrorCode::TooLarge);
    const int side = std::min(ThumbnailCache::pixelSize, std::max(width, height));
    const Pixbuf picture(gdk_pixbuf_new_from_file_at_scale(path.c_str(), side, side, TRUE, nullptr));
    if (!picture)
        return imageError(platform::ImageErrorCode::Damaged);
    return *imageOf(Pixbuf(gdk_pixbuf_apply_embedded_orientation(picture.get())));
}

} // namespace

/// The turn of one thread at a document's thumbnail; others wait for its end.
class ThumbnailCache::Turn {
public:
    Turn(ThumbnailCache& cache, const std::string& uri)
        : _cache(cache)
        , _uri(uri)
    {
        std::unique_lock lock(_cache._mutex);
        _cache._ended.wait(lock, [&] { return !_cache._beingMade.contains(_uri); });
        _cache._beingMade.insert(_uri);
    }
    ~Turn()
    {
        {
            const std::lock_guard lock(_cache._mutex);
            _cache._beingMade.erase(_uri);
        }
        _cache._ended.notify_all();
    }
    Turn(const Turn&) = delete;
    Turn& operator=(const Turn&) = delete;

private:
    ThumbnailCache& _cache;
    const std::string& _uri;
};

ThumbnailCache::ThumbnailCache(std::string folder, std::shared_ptr<const platform::ThumbnailMaker> maker)
    : _files(std::make_unique<const ThumbnailFiles>(std::move(folder)))
    , _maker(std::move(maker))
{
}

ThumbnailCache::~ThumbnailCache() = default;

std::string ThumbnailCache::sharedFolder()
{
    return std::string(g_get_user_cache_dir()) + "/thumbnails";
}

ThumbnailMap ThumbnailCache::thumbnails(
    const platform::Url& url, platform::Date modified, ThumbnailContent content)
{
    const ThumbnailVersion version(url.path(), modified);
    auto image = imageOf(_files->read(version, pixelSize));
    if (!image && content != ThumbnailContent::None)
        image = made(url.path(), version, content);
    if (image)
        return {{pixelSize, std::move(*image)}};
    for (const int side : {512, 256, 128}) {
        if (auto smaller = imageOf(_files->read(version, side)))
            return {{side, std::move(*smaller)}};
    }
    return {};
}

std::optional<Image> ThumbnailCache::made(
    const std::string& path, const ThumbnailVersion& version, ThumbnailContent content)
{
    const Turn turn(*this, version.uri);
    if (auto entry = imageOf(_files->read(version, pixelSize)))
        return entry; // another thread made it before this turn
    const int attempts = _files->attempts(version);
    if (attempts >= mostAttempts || isRefused(version))
        return std::nullopt;
    _files->noteAttempts(version, attempts + 1);
    auto image = make(path, content);
    if (!image) {
        noteFailure(version, *image.error);
        return std::nullopt;
    }
    _files->write(version, system::pixbufOf(*image).get());
    _files->noteAttempts(version, 0);
    return std::move(image.value);
}

Result<Image> ThumbnailCache::make(const std::string& path, ThumbnailContent content) const
{
    if (content == ThumbnailContent::Picture)
        return scaledPicture(path);
    if (!_maker)
        return Error(platform::errorDomain::system, ENOSYS);
    return _maker->makeThumbnail(path, content, pixelSize);
}

void ThumbnailCache::noteFailure(const ThumbnailVersion& version, const Error& error)
{
    _files->noteAttempts(version, isLasting(error) ? mostAttempts : 0);
    if (isLasting(error))
        return;
    const std::lock_guard lock(_mutex);
    _refused.insert(version.uri + ' ' + version.time);
}

bool ThumbnailCache::isRefused(const ThumbnailVersion& version) const
{
    const std::lock_guard lock(_mutex);
    return _refused.contains(version.uri + ' ' + version.time);
}

} // namespace host::drive
