// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/PixbufImage.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace host::system {

namespace {

std::uint32_t premultiplied(const guchar* pixel, bool hasAlpha)
{
    const std::uint32_t alpha = hasAlpha ? pixel[3] : 255;
    const auto component = [&](int index) { return (pixel[index] * alpha + 127) / 255; };
    return alpha << 24 | component(0) << 16 | component(1) << 8 | component(2);
}

void unpremultiply(std::uint32_t pixel, guchar* bytes)
{
    const std::uint32_t alpha = pixel >> 24;
    const auto component = [&](int shift) {
        const auto value = pixel >> shift & 255U;
        return static_cast<guchar>(alpha == 0 ? 0 : std::min((value * 255 + alpha / 2) / alpha, 255U));
    };
    bytes[0] = component(16);
    bytes[1] = component(8);
    bytes[2] = component(0);
    bytes[3] = static_cast<guchar>(alpha);
}

} // namespace

platform::Image imageOf(const GdkPixbuf* pixbuf, double scale)
{
    const int width = gdk_pixbuf_get_width(pixbuf), height = gdk_pixbuf_get_height(pixbuf);
    const auto rowBytes = static_cast<std::size_t>(gdk_pixbuf_get_rowstride(pixbuf));
    const auto channels = static_cast<std::size_t>(gdk_pixbuf_get_n_channels(pixbuf));
    const bool hasAlpha = gdk_pixbuf_get_has_alpha(pixbuf);
    const guchar* bytes = gdk_pixbuf_read_pixels(pixbuf);
    std::vector<std::uint32_t> pixels;
    pixels.reserve(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    for (int y = 0; y < height; ++y) {
        const guchar* row = bytes + static_cast<std::size_t>(y) * rowBytes;
        for (int x = 0; x < width; ++x)
            pixels.push_back(premultiplied(row + static_cast<std::size_t>(x) * channels, hasAlpha));
    }
    return platform::Image::fromPixels(width, height, scale, std::move(pixels));
}

Pixbuf pixbufOf(const platform::Image& image)
{
    if (image.pixels().empty())
        return nullptr;
    Pixbuf pixbuf(gdk_pixbuf_new(GDK_COLORSPACE_RGB, TRUE, 8, image.pixelWidth(), image.pixelHeight()));
    const auto rowBytes = static_cast<std::size_t>(gdk_pixbuf_get_rowstride(pixbuf.get()));
    const auto width = static_cast<std::size_t>(image.pixelWidth());
    auto* bytes = gdk_pixbuf_get_pixels(pixbuf.get());
    for (std::size_t i = 0; i < image.pixels().size(); ++i)
        unpremultiply(image.pixels()[i], bytes + i / width * rowBytes + i % width * 4);
    return pixbuf;
}

} // namespace host::system
