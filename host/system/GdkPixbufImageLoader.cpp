#include "host/system/GdkPixbufImageLoader.h"

#include "host/system/SystemErrors.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

namespace host::system {

using platform::Error;
using platform::Image;
using platform::ImageErrorCode;
using platform::ImageLimits;
using platform::Result;

namespace {

struct Unref {
    void operator()(GdkPixbuf* pixbuf) const { g_object_unref(pixbuf); }
};
using Pixbuf = std::unique_ptr<GdkPixbuf, Unref>;

Error imageError(ImageErrorCode code)
{
    return {platform::errorDomain::image, static_cast<int>(code)};
}

std::optional<Error> checkFile(const std::string& path, const ImageLimits& limits)
{
    struct stat status { };
    if (::stat(path.c_str(), &status) != 0)
        return errno == ENOENT ? Error(platform::FileErrorCode::NoSuchFile) : systemError(errno, path);
    // Anything but a regular file could keep the reader waiting.
    if (!S_ISREG(status.st_mode))
        return imageError(ImageErrorCode::Damaged);
    if (static_cast<std::uint64_t>(status.st_size) > limits.maxFileBytes)
        return imageError(ImageErrorCode::TooLarge);
    return std::nullopt;
}

struct PixelSize {
    int width, height;
    bool operator==(const PixelSize&) const = default;
};

/// The largest size of this shape that the limits allow.
PixelSize fitted(PixelSize size, const ImageLimits& limits)
{
    const double shrink = std::min({1.0, limits.maxWidth / static_cast<double>(size.width),
        limits.maxHeight / static_cast<double>(size.height)});
    const auto shrunk = [shrink](
                            int side) { return std::max(1, static_cast<int>(std::lround(side * shrink))); };
    return {shrunk(size.width), shrunk(size.height)};
}

/// The picture's own size, by its header.
Result<PixelSize> sizeInFile(const std::string& path, const ImageLimits& limits)
{
    int width = 0, height = 0;
    if (!gdk_pixbuf_get_file_info(path.c_str(), &width, &height) || width <= 0 || height <= 0)
        return imageError(ImageErrorCode::Damaged);
    if (static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(height) > limits.maxSourcePixels)
        return imageError(ImageErrorCode::TooLarge);
    return PixelSize{width, height};
}

/// Turns the picture as its camera noted. One that lay on its side was decoded to the wrong limits.
Pixbuf upright(const Pixbuf& decoded, const ImageLimits& limits)
{
    Pixbuf turned(gdk_pixbuf_apply_embedded_orientation(decoded.get()));
    if (!turned)
        return nullptr;
    const PixelSize size{gdk_pixbuf_get_width(turned.get()), gdk_pixbuf_get_height(turned.get())};
    const auto wanted = fitted(size, limits);
    if (wanted != size)
        turned.reset(gdk_pixbuf_scale_simple(turned.get(), wanted.width, wanted.height, GDK_INTERP_BILINEAR));
    return turned;
}

std::uint32_t premultiplied(const guchar* pixel, bool hasAlpha)
{
    const std::uint32_t alpha = hasAlpha ? pixel[3] : 255;
    const auto component = [&](int index) { return (pixel[index] * alpha + 127) / 255; };
    return alpha << 24 | component(0) << 16 | component(1) << 8 | component(2);
}

Image imageOf(const GdkPixbuf* pixbuf, double scale)
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
    return Image::fromPixels(width, height, scale, std::move(pixels));
}

} // namespace

Result<Image> GdkPixbufImageLoader::load(const std::string& path, const ImageLimits& limits) const
{
    if (const auto refused = checkFile(path, limits))
        return *refused;
    const auto size = sizeInFile(path, limits);
    if (!size)
        return *size.error;
    const auto wanted = fitted(*size, limits);
    const Pixbuf decoded(
        gdk_pixbuf_new_from_file_at_scale(path.c_str(), wanted.width, wanted.height, FALSE, nullptr));
    if (!decoded)
        return imageError(ImageErrorCode::Damaged);
    const auto shown = upright(decoded, limits);
    return shown ? imageOf(shown.get(), limits.scale) : Result<Image>(imageError(ImageErrorCode::Damaged));
}

} // namespace host::system
