// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Image.h"

namespace platform {

Image Image::fromPixels(int pixelWidth, int pixelHeight, double scale, std::vector<std::uint32_t> pixels)
{
    pixels.resize(static_cast<std::size_t>(pixelWidth) * static_cast<std::size_t>(pixelHeight));
    return Image(std::make_shared<Data>(Data{pixelWidth, pixelHeight, scale, std::move(pixels), {}, 0}));
}

Image Image::named(std::string iconName, double pointSize)
{
    return Image(std::make_shared<Data>(Data{0, 0, 1, {}, std::move(iconName), pointSize}));
}

bool Image::operator==(const Image& other) const
{
    return _data == other._data || (isNamed() && iconName() == other.iconName() && size() == other.size());
}

} // namespace platform
