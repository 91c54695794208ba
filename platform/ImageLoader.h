// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Image.h"

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace platform {

/// The domain of errors that concern a picture's content.
namespace errorDomain {
inline constexpr std::string_view image = "app.tarrow.Drive.image"; ///< codes: ImageErrorCode
} // namespace errorDomain

/// Why a picture cannot be shown although its file can be read.
enum class ImageErrorCode : int {
    Damaged = 1, ///< the content is no picture that can be shown, or the path is no regular file's
    TooLarge = 2, ///< the picture has more pixels or bytes than the limits allow
    Cancelled = 3, ///< the caller does not want the picture any more
};

/// How much of a picture is kept, and how much is looked at. Pictures come from other people, so every
/// decoding is bounded.
struct ImageLimits {
    /// The largest sides of the result in pixels. A larger picture is made smaller and keeps its shape.
    int maxWidth = 4096, maxHeight = 4096;
    double scale = 1; ///< how many pixels of the result make a point of the interface
    std::uint64_t maxFileBytes = 256ULL << 20; ///< a larger file is refused unread
    std::uint64_t maxSourcePixels = 100'000'000; ///< a picture with more is refused when its header says so
    /// A photo in which the rows follow each other is made smaller while it is read, so it may have this many
    /// pixels.
    std::uint64_t maxScaledSourcePixels = 1'000'000'000;
    std::uint64_t maxAnimationBytes = 64ULL
        << 20; ///< an animation that takes more shows its first frame only
    std::uint64_t maxPixels = 0; ///< the most pixels of the result in all; 0: as many as the sides allow
};

/// A picture as it is shown: one frame, or several in turn.
struct Picture {
    struct Frame {
        Image image;
        int milliseconds = 0; ///< how long the frame is shown; 0: for good
    };
    std::vector<Frame> frames; ///< at least one; all are of one size
    int sourceWidth = 0, sourceHeight = 0; ///< the file's own size in pixels, turned as the camera was held
    bool breaksOff = false; ///< the file is damaged or ends early; the frames show what could be read
};

/// Decodes picture files. Any thread may call; a call waits for the file and takes as long as the decoding,
/// so it is not for the main thread. Several calls may run at once.
class ImageLoader {
public:
    virtual ~ImageLoader() = default;

    /// Answers the picture in the file at a path, turned as its camera noted; of an animation it answers the
    /// first frame. A picture that breaks off is answered as far as it goes. Errors:
    /// FileErrorCode::NoSuchFile when nothing is there (a promise is nothing), ImageErrorCode, or the
    /// system's error.
    virtual Result<Image> load(const std::string& path, const ImageLimits& limits) const = 0;

    /// Does the same for all frames. `isCancelled` is asked about every 64 KiB of the file and for every
    /// frame, on the calling thread; once it answers true the call ends with ImageErrorCode::Cancelled.
    virtual Result<Picture> loadPicture(const std::string& path, const ImageLimits& limits,
        const std::function<bool()>& isCancelled) const = 0;
};

} // namespace platform
