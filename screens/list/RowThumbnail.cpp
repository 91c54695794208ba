// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/RowThumbnail.h"

#include "platform/CloudDocumentService.h"
#include "platform/Services.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

namespace screens {

namespace {

/// The rectangle of source pixels that becomes one pixel.
struct Area {
    int left, top, right, bottom;
};

std::uint32_t mean(const Image& image, const Area& area)
{
    std::array<std::uint64_t, 4> sums{};
    for (int y = area.top; y < area.bottom; ++y) {
        const auto* row = image.pixels().data()
            + static_cast<std::size_t>(y) * static_cast<std::size_t>(image.pixelWidth());
        for (int x = area.left; x < area.right; ++x) {
            for (std::size_t channel = 0; channel < 4; ++channel)
                sums[channel] += row[x] >> (8 * channel) & 0xff;
        }
    }
    const auto count = static_cast<std::uint64_t>(area.right - area.left)
        * static_cast<std::uint64_t>(area.bottom - area.top);
    std::uint32_t pixel = 0;
    for (std::size_t channel = 0; channel < 4; ++channel)
        pixel |= static_cast<std::uint32_t>((sums[channel] + count / 2) / count) << (8 * channel);
    return pixel;
}

/// Answers where the source pixels for one of `count` pixels begin and end.
std::pair<int, int> part(int index, int count, int length)
{
    const auto at = [&](int place) {
        return static_cast<int>(static_cast<std::int64_t>(place) * length / count);
    };
    return {at(index), std::max(at(index + 1), at(index) + 1)};
}

/// Answers a pixel with black of this opacity over it, as far as the pixel covers what is behind it.
std::uint32_t darkened(std::uint32_t pixel, double opacity)
{
    std::uint32_t result = pixel & 0xff000000U;
    for (const int shift : {0, 8, 16}) {
        const auto value = static_cast<double>(pixel >> shift & 0xff) * (1 - opacity);
        result |= static_cast<std::uint32_t>(std::lround(value)) << shift;
    }
    return result;
}

/// Answers an image with an edge of one point, without which a white page is not seen on a white list.
Image edged(const Image& image)
{
    constexpr double opacity = 0.16;
    const int width = image.pixelWidth(), height = image.pixelHeight();
    const int edge = static_cast<int>(image.scale());
    auto pixels = image.pixels();
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            if (std::min({x, y, width - 1 - x, height - 1 - y}) < edge) {
                auto& pixel = pixels[static_cast<std::size_t>(y) * static_cast<std::size_t>(width)
                    + static_cast<std::size_t>(x)];
                pixel = darkened(pixel, opacity);
            }
        }
    }
    return Image::fromPixels(width, height, image.scale(), std::move(pixels));
}

} // namespace

Image scaledDown(const Image& image, int side)
{
    const int longer = std::max(image.pixelWidth(), image.pixelHeight());
    if (image.isNamed() || longer <= side)
        return image;
    const auto scaled = [&](int length) {
        return static_cast<int>(std::max<std::int64_t>(1, static_cast<std::int64_t>(length) * side / longer));
    };
    const int width = scaled(image.pixelWidth()), height = scaled(image.pixelHeight());
    std::vector<std::uint32_t> pixels;
    pixels.reserve(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    for (int y = 0; y < height; ++y) {
        const auto [top, bottom] = part(y, height, image.pixelHeight());
        for (int x = 0; x < width; ++x) {
            const auto [left, right] = part(x, width, image.pixelWidth());
            pixels.push_back(mean(image, {left, top, right, bottom}));
        }
    }
    return Image::fromPixels(width, height, 2, std::move(pixels));
}

std::optional<Image> readRowThumbnail(const Url& url)
{
    constexpr AttributeKey keys[] = {AttributeKey::ThumbnailMap};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    const auto* thumbnails = values ? values->get<ThumbnailMap>(AttributeKey::ThumbnailMap) : nullptr;
    if (!thumbnails || thumbnails->empty())
        return std::nullopt;
    return edged(scaledDown(thumbnails->front().image, rowThumbnailSide));
}

} // namespace screens
