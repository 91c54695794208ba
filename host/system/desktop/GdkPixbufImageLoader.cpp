// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GdkPixbufImageLoader.h"

#include "host/system/desktop/GifFrames.h"
#include "host/system/desktop/JpegEnd.h"
#include "host/system/desktop/JpegRows.h"
#include "host/system/desktop/PixbufImage.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemErrors.h"

#include <fcntl.h>
#include <gdk-pixbuf/gdk-pixbuf.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cmath>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

namespace host::system {

using platform::Error;
using platform::Image;
using platform::ImageErrorCode;
using platform::ImageLimits;
using platform::Picture;
using platform::Result;

namespace {

using Animation = std::unique_ptr<GdkPixbufAnimation, UnrefObject>;
using Cancelled = std::function<bool()>;

Error imageError(ImageErrorCode code)
{
    return {platform::errorDomain::image, static_cast<int>(code)};
}

std::optional<Error> checkFile(const std::string& path, const ImageLimits& limits)
{
    struct stat status { };
    if (::stat(path.c_str(), &status) != 0)
        return errno == ENOENT ? Error(platform::FileErrorCode::NoSuchFile) : systemError(errno, path);
    // Only a regular file is opened, because reading a pipe or a device could block for ever.
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

/// Answers the largest size of this shape within the limits.
PixelSize fitted(PixelSize size, const ImageLimits& limits)
{
    const double width = size.width, height = size.height;
    double shrink = std::min({1.0, limits.maxWidth / width, limits.maxHeight / height});
    if (limits.maxPixels > 0)
        shrink = std::min(shrink, std::sqrt(static_cast<double>(limits.maxPixels) / (width * height)));
    const auto shrunk = [shrink](
                            int side) { return std::max(1, static_cast<int>(std::lround(side * shrink))); };
    return {shrunk(size.width), shrunk(size.height)};
}

/// Answers the size to decode to while it is not known whether the picture has to be turned.
PixelSize fittedEitherWay(PixelSize size, const ImageLimits& limits)
{
    const auto lying = fitted({size.height, size.width}, limits);
    const auto standing = fitted(size, limits);
    return lying.height > standing.width ? PixelSize{lying.height, lying.width} : standing;
}

/// Answers how many pixels the decoder makes of a JPEG picture that is wanted in a smaller size. It leaves
/// out a half, three quarters or seven eighths of each side, as long as the result is not too small.
std::uint64_t pixelsOfScaledJpeg(PixelSize size, PixelSize wanted)
{
    constexpr int mostShrunk = 8;
    int divisor = 1;
    while (divisor < mostShrunk && size.width / (2 * divisor) >= wanted.width
        && size.height / (2 * divisor) >= wanted.height)
        divisor *= 2;
    return static_cast<std::uint64_t>(size.width / divisor)
        * static_cast<std::uint64_t>(size.height / divisor);
}

/// Reads the picture's own size from its header.
Result<PixelSize> sizeInFile(const std::string& path, const ImageLimits& limits)
{
    int width = 0, height = 0;
    if (!gdk_pixbuf_get_file_info(path.c_str(), &width, &height) || width <= 0 || height <= 0)
        return imageError(ImageErrorCode::Damaged);
    const PixelSize size{width, height};
    const auto pixels = static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(height);
    const bool isScaled =
        pixels > limits.maxSourcePixels && pixels <= limits.maxScaledSourcePixels && isJpegInRows(path);
    if ((isScaled ? pixelsOfScaledJpeg(size, fittedEitherWay(size, limits)) : pixels)
        > limits.maxSourcePixels)
        return imageError(ImageErrorCode::TooLarge);
    return size;
}

/// Turns the picture as its camera noted, and scales it down to the limits.
Pixbuf upright(const GdkPixbuf* decoded, const ImageLimits& limits)
{
    Pixbuf turned(gdk_pixbuf_apply_embedded_orientation(const_cast<GdkPixbuf*>(decoded)));
    if (!turned)
        return nullptr;
    const PixelSize size{gdk_pixbuf_get_width(turned.get()), gdk_pixbuf_get_height(turned.get())};
    const auto wanted = fitted(size, limits);
    if (wanted != size)
        turned.reset(gdk_pixbuf_scale_simple(turned.get(), wanted.width, wanted.height, GDK_INTERP_BILINEAR));
    return turned;
}

/// A file that is read piece by piece, so that the reading can be cancelled.
class PictureFile {
public:
    explicit PictureFile(const std::string& path)
        : _file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK))
    {
    }
    bool isOpen() const { return static_cast<bool>(_file); }

    /// Answers nothing after the end or an error.
    std::string_view next()
    {
        ssize_t count = 0;
        do
            count = ::read(_file.get(), _buffer.data(), _buffer.size());
        while (count < 0 && errno == EINTR);
        return {_buffer.data(), count > 0 ? static_cast<std::size_t>(count) : 0};
    }

private:
    FileDescriptor _file;
    std::array<char, 64 << 10> _buffer{};
};

/// The library's decoder. When it is cancelled, it ends without looking at the bytes so far.
class Decoder {
public:
    explicit Decoder(PixelSize size)
        : _loader(gdk_pixbuf_loader_new())
        , _size(size)
    {
        g_signal_connect(_loader.get(), "size-prepared",
            G_CALLBACK(+[](GdkPixbufLoader* loader, int, int, const PixelSize* wanted) {
                gdk_pixbuf_loader_set_size(loader, wanted->width, wanted->height);
            }),
            &_size);
    }
    ~Decoder() { end(); }
    Decoder(const Decoder&) = delete;
    Decoder& operator=(const Decoder&) = delete;

    bool feed(std::string_view bytes)
    {
        const auto* data = reinterpret_cast<const guchar*>(bytes.data());
        return gdk_pixbuf_loader_write(_loader.get(), data, bytes.size(), nullptr) != FALSE;
    }
    /// Answers false when the picture is not complete.
    bool end()
    {
        return std::exchange(_ended, true) || gdk_pixbuf_loader_close(_loader.get(), nullptr) != FALSE;
    }
    Animation animation() const
    {
        auto* found = gdk_pixbuf_loader_get_animation(_loader.get());
        if (found)
            g_object_ref(found);
        return Animation(found);
    }

private:
    std::unique_ptr<GdkPixbufLoader, UnrefObject> _loader;
    PixelSize _size;
    bool _ended = false;
};

struct Decoded {
    Animation animation;
    std::size_t frames = 1;
    bool breaksOff = false;
};

Result<Decoded> decode(const std::string& path, PixelSize size, const Cancelled& isCancelled)
{
    PictureFile file(path);
    if (!file.isOpen())
        return systemError(errno, path);
    Decoder decoder(size);
    std::string gif; // the bytes, as long as they may be an animation's
    JpegEnd jpegEnd;
    bool breaksOff = false, isFirst = true;
    for (auto piece = file.next(); !piece.empty(); piece = file.next()) {
        if (isCancelled())
            return imageError(ImageErrorCode::Cancelled);
        if (!gif.empty() || (isFirst && piece.starts_with("GIF8")))
            gif += piece;
        jpegEnd.feed(piece);
        isFirst = false;
        breaksOff = !decoder.feed(piece);
        if (breaksOff)
            break;
    }
    breaksOff = !decoder.end() || breaksOff || jpegEnd.isMissing();
    auto animation = decoder.animation();
    if (!animation)
        return imageError(ImageErrorCode::Damaged);
    return Decoded{std::move(animation), std::max<std::size_t>(1, gifFrameCount(gif)), breaksOff};
}

// The library's animations know only this type of time, which GLib has deprecated.
G_GNUC_BEGIN_IGNORE_DEPRECATIONS
using AnimationTime = GTimeVal;
G_GNUC_END_IGNORE_DEPRECATIONS

void advance(AnimationTime& time, int milliseconds)
{
    constexpr glong perSecond = 1'000'000;
    time.tv_usec += glong{milliseconds} * 1000;
    time.tv_sec += time.tv_usec / perSecond;
    time.tv_usec %= perSecond;
}

std::vector<Picture::Frame> framesOf(
    const Decoded& decoded, const ImageLimits& limits, const Cancelled& isCancelled)
{
    std::vector<Picture::Frame> frames;
    AnimationTime now{};
    const std::unique_ptr<GdkPixbufAnimationIter, UnrefObject> step(
        gdk_pixbuf_animation_get_iter(decoded.animation.get(), &now));
    while (frames.size() < decoded.frames && !isCancelled()) {
        const auto shown = upright(gdk_pixbuf_animation_iter_get_pixbuf(step.get()), limits);
        const int delay = gdk_pixbuf_animation_iter_get_delay_time(step.get());
        if (!shown)
            break;
        frames.push_back({imageOf(shown.get(), limits.scale), std::max(delay, 0)});
        if (delay < 0)
            break;
        advance(now, std::max(delay, 1));
        gdk_pixbuf_animation_iter_advance(step.get(), &now);
    }
    return frames;
}

bool isMoving(const Decoded& decoded, PixelSize size, const ImageLimits& limits)
{
    const auto bytes =
        static_cast<std::uint64_t>(size.width) * static_cast<std::uint64_t>(size.height) * 4 * decoded.frames;
    return decoded.frames > 1 && bytes <= limits.maxAnimationBytes
        && !gdk_pixbuf_animation_is_static_image(decoded.animation.get());
}

Picture stillOf(const Decoded& decoded, const ImageLimits& limits)
{
    Picture picture;
    const auto* pixbuf = gdk_pixbuf_animation_get_static_image(decoded.animation.get());
    const auto shown = pixbuf ? upright(pixbuf, limits) : nullptr;
    if (shown)
        picture.frames.push_back({imageOf(shown.get(), limits.scale), 0});
    return picture;
}

} // namespace

Result<Image> GdkPixbufImageLoader::load(const std::string& path, const ImageLimits& limits) const
{
    auto still = limits;
    still.maxAnimationBytes = 0;
    const auto picture = loadPicture(path, still, [] { return false; });
    return picture ? Result<Image>(picture->frames.front().image) : Result<Image>(*picture.error);
}

Result<Picture> GdkPixbufImageLoader::loadPicture(
    const std::string& path, const ImageLimits& limits, const Cancelled& isCancelled) const
{
    if (const auto refused = checkFile(path, limits))
        return *refused;
    const auto size = sizeInFile(path, limits);
    if (!size)
        return *size.error;
    const auto wanted = fittedEitherWay(*size, limits);
    const auto decoded = decode(path, wanted, isCancelled);
    if (!decoded)
        return *decoded.error;
    auto picture = stillOf(*decoded.value, limits);
    picture.breaksOff = decoded->breaksOff;
    if (isMoving(*decoded.value, wanted, limits))
        picture.frames = framesOf(*decoded.value, limits, isCancelled);
    if (isCancelled())
        return imageError(ImageErrorCode::Cancelled);
    if (picture.frames.empty())
        return imageError(ImageErrorCode::Damaged);
    const auto& shown = picture.frames.front().image;
    const bool wasTurned = (shown.pixelWidth() < shown.pixelHeight()) != (size->width < size->height)
        && size->width != size->height;
    picture.sourceWidth = wasTurned ? size->height : size->width;
    picture.sourceHeight = wasTurned ? size->width : size->height;
    return picture;
}

} // namespace host::system
