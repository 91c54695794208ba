// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/drawing/CairoImageContext.h"

#include "host/system/drawing/CairoCanvas.h"

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace host::system {

using platform::Image;
using platform::Size;

namespace {

/// Cairo refuses larger surfaces.
constexpr double longestSide = 32767;

using Surface = std::unique_ptr<cairo_surface_t, decltype(&cairo_surface_destroy)>;
using Context = std::unique_ptr<cairo_t, decltype(&cairo_destroy)>;

class CairoImageContext : public kit::ImageContext {
public:
    CairoImageContext(Surface surface, double scale)
        : _surface(std::move(surface))
        , _cairo(cairo_create(_surface.get()), &cairo_destroy)
        , _canvas(_cairo.get())
        , _scale(scale)
    {
        cairo_scale(_cairo.get(), scale, scale);
    }

    kit::Canvas& canvas() override { return _canvas; }

    Image image() override
    {
        cairo_surface_flush(_surface.get());
        const int width = cairo_image_surface_get_width(_surface.get());
        const int height = cairo_image_surface_get_height(_surface.get());
        // A row of 32-bit pixels needs no padding in Cairo.
        const auto* first =
            reinterpret_cast<const std::uint32_t*>(cairo_image_surface_get_data(_surface.get()));
        const auto count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
        return Image::fromPixels(width, height, _scale, std::vector<std::uint32_t>(first, first + count));
    }

private:
    Surface _surface;
    Context _cairo;
    CairoCanvas _canvas;
    double _scale;
};

/// Answers the whole pixels of a length, whose arithmetic may have left a trace of the next pixel.
double pixels(double points, double scale)
{
    return std::ceil(points * scale - 1e-6);
}

} // namespace

std::unique_ptr<kit::ImageContext> openImageContext(const Size& size, double scale)
{
    const double width = pixels(size.width, scale), height = pixels(size.height, scale);
    const auto fits = [](double side) { return side >= 1 && side <= longestSide; };
    if (!(scale > 0) || !fits(width) || !fits(height))
        return nullptr;
    Surface surface(
        cairo_image_surface_create(CAIRO_FORMAT_ARGB32, static_cast<int>(width), static_cast<int>(height)),
        &cairo_surface_destroy);
    if (cairo_surface_status(surface.get()) != CAIRO_STATUS_SUCCESS)
        return nullptr;
    return std::make_unique<CairoImageContext>(std::move(surface), scale);
}

} // namespace host::system
