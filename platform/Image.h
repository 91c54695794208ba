// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace platform {

/// An immutable picture, cheap to copy: either pixels, or the name of an icon of the platform's icon theme
/// that is looked up where it is shown (so that it follows the theme and the scale of its window).
class Image {
public:
    /// Pixels as 32-bit words 0xAARRGGBB in native byte order, premultiplied alpha, rows without padding.
    /// `scale` is the number of pixels to a point.
    static Image fromPixels(int pixelWidth, int pixelHeight, double scale, std::vector<std::uint32_t> pixels);

    /// An icon of the icon theme (the naming follows the freedesktop icon naming conventions).
    static Image named(std::string iconName);

    bool isNamed() const { return !_data->iconName.empty(); }
    const std::string& iconName() const { return _data->iconName; }

    /// Size in points; zero for a named icon, whose size is given where it is shown.
    Size size() const { return {_data->pixelWidth / _data->scale, _data->pixelHeight / _data->scale}; }
    int pixelWidth() const { return _data->pixelWidth; }
    int pixelHeight() const { return _data->pixelHeight; }
    double scale() const { return _data->scale; }
    const std::vector<std::uint32_t>& pixels() const { return _data->pixels; }

    /// Two images are equal when they are the same object or name the same icon.
    bool operator==(const Image& other) const;

private:
    struct Data {
        int pixelWidth = 0, pixelHeight = 0;
        double scale = 1;
        std::vector<std::uint32_t> pixels;
        std::string iconName;
    };
    explicit Image(std::shared_ptr<const Data> data)
        : _data(std::move(data))
    {
    }

    std::shared_ptr<const Data> _data;
};

} // namespace platform
