// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace platform {

/// An immutable picture. It is either pixels, or the name of an icon of the platform's icon theme, which is
/// looked up where it is shown because it follows the theme and the scale of its window. An image is cheap to
/// copy, because copies share their pixels; any thread may use it.
class Image {
public:
    /// Makes an image of pixels: 32-bit words 0xAARRGGBB in native byte order with premultiplied alpha, row
    /// by row from the top, without padding. `scale` is the number of pixels to a point of the interface.
    /// Pixels that are missing at the end are transparent.
    static Image fromPixels(int pixelWidth, int pixelHeight, double scale, std::vector<std::uint32_t> pixels);

    /// Makes an image of an icon's name, by the freedesktop icon naming conventions, such as
    /// "folder-symbolic". Whether the theme has it shows only where it is drawn. An icon may have a side in
    /// points of its own; without one its size is given where it is shown.
    static Image named(std::string iconName, double pointSize = 0);

    /// Whether the image is an icon's name.
    bool isNamed() const { return !_data->iconName.empty(); }
    /// The icon's name; empty for an image of pixels.
    const std::string& iconName() const { return _data->iconName; }

    /// The size in points; zero for a named icon without a size of its own.
    Size size() const
    {
        return isNamed() ? Size{_data->pointSize, _data->pointSize}
                         : Size{_data->pixelWidth / _data->scale, _data->pixelHeight / _data->scale};
    }
    /// The size in pixels; zero for a named icon.
    int pixelWidth() const { return _data->pixelWidth; }
    int pixelHeight() const { return _data->pixelHeight; }
    /// The number of pixels to a point.
    double scale() const { return _data->scale; }
    /// The pixels as fromPixels() took them; empty for a named icon.
    const std::vector<std::uint32_t>& pixels() const { return _data->pixels; }

    /// Two images are equal when they share their pixels or name the same icon in the same size; pixels are
    /// never compared.
    bool operator==(const Image& other) const;

private:
    struct Data {
        int pixelWidth = 0, pixelHeight = 0;
        double scale = 1;
        std::vector<std::uint32_t> pixels;
        std::string iconName;
        double pointSize = 0; ///< of a named icon
    };
    explicit Image(std::shared_ptr<const Data> data)
        : _data(std::move(data))
    {
    }

    std::shared_ptr<const Data> _data;
};

} // namespace platform
