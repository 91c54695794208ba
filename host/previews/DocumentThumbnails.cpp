// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/DocumentThumbnails.h"

#include "host/previews/FilmFrame.h"
#include "host/previews/PopplerDocuments.h"
#include "platform/ImageLoader.h"

#include <algorithm>

namespace host::previews {

using platform::Error;
using platform::Image;
using platform::Result;
using platform::ThumbnailContent;

namespace {

Result<Image> firstPage(const std::string& path, int pixelSize)
{
    const auto document = PopplerDocuments().open(path);
    if (!document)
        return *document.error;
    const auto size = (*document)->pageSize(0);
    // The shorter side of a long strip still gets a pixel.
    const double pixelsPerPoint = pixelSize / std::max(size.width, size.height);
    const double least = 1 / pixelsPerPoint;
    return (*document)->renderPage(
        0, pixelsPerPoint, {0, 0, std::max(size.width, least), std::max(size.height, least)});
}

} // namespace

Result<Image> DocumentThumbnails::makeThumbnail(
    const std::string& path, ThumbnailContent content, int pixelSize) const
{
    switch (content) {
    case ThumbnailContent::Pages:
        return firstPage(path, pixelSize);
    case ThumbnailContent::Film:
        return frameOfFilm(path, pixelSize);
    default:
        return Error(platform::errorDomain::image, static_cast<int>(platform::ImageErrorCode::Damaged));
    }
}

} // namespace host::previews
