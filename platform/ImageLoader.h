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

namespace errorDomain {
inline constexpr std::string_view image = "app.tarrow.Drive.image"; ///< codes: ImageErrorCode
} // namespace errorDomain

enum class ImageErrorCode : int {
    Damaged = 1, ///< the content is no picture (one that breaks off may show as far as it goes)
    TooLarge = 2, ///< more pixels or bytes than the limits allow to look at
    Cancelled = 3, ///< the caller said that it is no longer wanted
};

/// How much of a picture is kept and looked at.
struct ImageLimits {
    int maxWidth = 4096, maxHeight = 4096; ///< pixels; a larger picture is made smaller, its shape kept
    double scale = 1; ///< pixels to a point of the result
    std::uint64_t maxFileBytes = 256ULL << 20; ///< a larger file is refused unread
    std::uint64_t maxSourcePixels = 100'000'000; ///< a picture with more is refused when its header says so
    std::uint64_t maxAnimationBytes = 64ULL << 20; ///< an animation with more shows its first frame only
    std::uint64_t maxPixels = 0; ///< of the result, in all; 0: as the sides allow
};

/// A picture as it is shown: one frame, or several in turn.
struct Picture {
    struct Frame {
        Image image;
        int milliseconds = 0; ///< how long it is shown; 0: for good
    };
    std::vector<Frame> frames; ///< all of one size
    int sourceWidth = 0, sourceHeight = 0; ///< pixels of the file, as its camera was held
    bool breaksOff = false; ///< the file is damaged further down: what could be read is here
};

/// Decodes picture files. Any thread; a call waits for the file and takes as long as the decoding.
class ImageLoader {
public:
    virtual ~ImageLoader() = default;

    /// The picture in the file at a path, turned as its camera noted; of an animation the first frame.
    /// Errors: FileErrorCode::NoSuchFile, ImageErrorCode, or the system's error.
    virtual Result<Image> load(const std::string& path, const ImageLimits& limits) const = 0;

    /// The same with all frames. `isCancelled` is asked often, on the calling thread; once it answers true
    /// the call ends soon with ImageErrorCode::Cancelled.
    virtual Result<Picture> loadPicture(const std::string& path, const ImageLimits& limits,
        const std::function<bool()>& isCancelled) const = 0;
};

} // namespace platform
