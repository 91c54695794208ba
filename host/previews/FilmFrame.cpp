// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/FilmFrame.h"

#include "platform/ImageLoader.h"

#include <gst/gst.h>

#include <bit>
#include <cerrno>
#include <chrono>
#include <cstddef>
#include <cstring>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host::previews {

using platform::Error;
using platform::Image;
using platform::ImageErrorCode;
using platform::Result;

namespace {

constexpr auto timeLimit = std::chrono::seconds(5);
/// A film with larger frames is refused before one is decoded.
constexpr int longestSourceSide = 8192;

template <auto unref>
struct Unref {
    template <typename T>
    void operator()(T* object) const
    {
        unref(object);
    }
};
using Element = std::unique_ptr<GstElement, Unref<gst_object_unref>>;
using Sample = std::unique_ptr<GstSample, Unref<gst_sample_unref>>;
using Message = std::unique_ptr<GstMessage, Unref<gst_message_unref>>;
using Bus = std::unique_ptr<GstBus, Unref<gst_object_unref>>;

Error imageError(ImageErrorCode code)
{
    return {platform::errorDomain::image, static_cast<int>(code)};
}

Error missingParts()
{
    return {platform::errorDomain::system, ENOSYS};
}

/// Says which elements may read a film: none that reads from elsewhere, because a file that is a list of
/// addresses must not make the program call anybody. The numbers are those of the decoder's signal.
int selectElement(GstElement*, GstPad*, GstCaps*, GstElementFactory* factory, gpointer)
{
    constexpr int tryIt = 0, skipIt = 2;
    const std::string_view kind(gst_element_factory_get_metadata(factory, GST_ELEMENT_METADATA_KLASS));
    const auto is = [&](std::string_view part) { return kind.find(part) != std::string_view::npos; };
    return is("Adaptive") || is("Network") || is("Source") ? skipIt : tryIt;
}

/// A pipeline that shows single frames of a film. It stops when it ends.
class FrameReader {
public:
    static std::optional<FrameReader> open(const std::string& path, int pixelSize)
    {
        const auto sides = [](int most) {
            const auto range = "=[1," + std::to_string(most) + "]";
            return "width" + range + ",height" + range;
        };
        // Bytes in this order are the words of an image, but for the alpha.
        const std::string format = std::endian::native == std::endian::little ? "BGRx" : "xRGB";
        const auto description = "filesrc name=file ! decodebin name=decoder expose-all-streams=false "
                                 "caps=video/x-raw ! video/x-raw,"
            + sides(longestSourceSide)
            + " ! videoconvert ! videoscale ! videoflip video-direction=auto ! appsink name=frames "
              "sync=false "
              "max-buffers=1 caps=video/x-raw,format="
            + format + ",pixel-aspect-ratio=1/1," + sides(pixelSize);
        GError* problem = nullptr;
        Element pipeline(gst_parse_launch(description.c_str(), &problem));
        const bool isWhole = pipeline && !problem;
        g_clear_error(&problem);
        if (!isWhole)
            return std::nullopt;
        return FrameReader(std::move(pipeline), path);
    }

    FrameReader(FrameReader&&) = default;
    FrameReader& operator=(FrameReader&&) = delete;
    ~FrameReader()
    {
        if (_pipeline)
            gst_element_set_state(_pipeline.get(), GST_STATE_NULL);
    }

    Result<Image> read()
    {
        gst_element_set_state(_pipeline.get(), GST_STATE_PAUSED);
        if (const auto reason = waitForFrame())
            return *reason;
        auto sample = shownFrame();
        gint64 length = 0;
        constexpr auto flags = static_cast<GstSeekFlags>(GST_SEEK_FLAG_FLUSH | GST_SEEK_FLAG_KEY_UNIT);
        // A film that is cut short has its first frame only.
        if (gst_element_query_duration(_pipeline.get(), GST_FORMAT_TIME, &length) && length > 0
            && gst_element_seek_simple(_pipeline.get(), GST_FORMAT_TIME, flags, length / 10)
            && !waitForFrame()) {
            if (auto later = shownFrame())
                sample = std::move(later);
        }
        return sample ? imageOf(*sample) : imageError(ImageErrorCode::Damaged);
    }

private:
    FrameReader(Element pipeline, const std::string& path)
        : _pipeline(std::move(pipeline))
    {
        g_object_set(child("file").get(), "location", path.c_str(), nullptr);
        g_signal_connect(child("decoder").get(), "autoplug-select", G_CALLBACK(selectElement), nullptr);
    }

    Element child(const char* name) const
    {
        return Element(gst_bin_get_by_name(GST_BIN(_pipeline.get()), name));
    }

    GstClockTime remaining() const
    {
        const auto left = _end - std::chrono::steady_clock::now();
        return left.count() > 0 ? static_cast<GstClockTime>(std::chrono::nanoseconds(left).count()) : 0;
    }

    /// Waits for the next frame to be shown. Answers the reason when none comes.
    std::optional<Error> waitForFrame() const
    {
        const Bus bus(gst_element_get_bus(_pipeline.get()));
        constexpr auto wanted = static_cast<GstMessageType>(GST_MESSAGE_ERROR | GST_MESSAGE_ASYNC_DONE);
        const Message message(gst_bus_timed_pop_filtered(bus.get(), remaining(), wanted));
        if (!message)
            return Error(platform::errorDomain::system, ETIMEDOUT);
        return GST_MESSAGE_TYPE(message.get()) == GST_MESSAGE_ERROR ? std::optional(reasonOf(*message))
                                                                    : std::nullopt;
    }

    Sample shownFrame() const
    {
        GstSample* shown = nullptr;
        g_signal_emit_by_name(child("frames").get(), "try-pull-preroll", remaining(), &shown);
        return Sample(shown);
    }

    static Error reasonOf(GstMessage& message)
    {
        GError* problem = nullptr;
        gst_message_parse_error(&message, &problem, nullptr);
        const bool lacksPart = g_error_matches(problem, GST_CORE_ERROR, GST_CORE_ERROR_MISSING_PLUGIN)
            || g_error_matches(problem, GST_STREAM_ERROR, GST_STREAM_ERROR_CODEC_NOT_FOUND);
        const bool cannotOpen = problem->domain == GST_RESOURCE_ERROR;
        g_clear_error(&problem);
        return lacksPart || cannotOpen ? missingParts() : imageError(ImageErrorCode::Damaged);
    }

    static Result<Image> imageOf(GstSample& sample)
    {
        int width = 0, height = 0;
        const auto* form = gst_caps_get_structure(gst_sample_get_caps(&sample), 0);
        gst_structure_get_int(form, "width", &width);
        gst_structure_get_int(form, "height", &height);
        const auto count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
        GstMapInfo map;
        auto* buffer = gst_sample_get_buffer(&sample);
        if (count == 0 || !buffer || !gst_buffer_map(buffer, &map, GST_MAP_READ))
            return imageError(ImageErrorCode::Damaged);
        std::vector<std::uint32_t> pixels(map.size >= count * 4 ? count : 0);
        std::memcpy(pixels.data(), map.data, pixels.size() * 4);
        gst_buffer_unmap(buffer, &map);
        for (auto& pixel : pixels)
            pixel |= 0xFF000000U;
        return pixels.empty() ? Result<Image>(imageError(ImageErrorCode::Damaged))
                              : Image::fromPixels(width, height, 1, std::move(pixels));
    }

    Element _pipeline;
    std::chrono::steady_clock::time_point _end = std::chrono::steady_clock::now() + timeLimit;
};

} // namespace

Result<Image> frameOfFilm(const std::string& path, int pixelSize)
{
    if (!gst_init_check(nullptr, nullptr, nullptr))
        return missingParts();
    auto reader = FrameReader::open(path, pixelSize);
    return reader ? reader->read() : missingParts();
}

} // namespace host::previews
