#pragma once

#include "platform/Error.h"
#include "platform/Image.h"

#include <cstdint>
#include <string>

namespace platform {

namespace errorDomain {
inline constexpr std::string_view image = "app.tarrow.Drive.image"; ///< codes: ImageErrorCode
} // namespace errorDomain

enum class ImageErrorCode : int {
    Damaged = 1, ///< the content is no picture (one that breaks off may show as far as it goes)
    TooLarge = 2, ///< more pixels or bytes than the limits allow to look at
};

/// How much of a picture is kept and looked at.
struct ImageLimits {
    int maxWidth = 4096, maxHeight = 4096; ///< pixels; a larger picture is made smaller, its shape kept
    double scale = 1; ///< pixels to a point of the result
    std::uint64_t maxFileBytes = 256ULL << 20; ///< a larger file is refused unread
    std::uint64_t maxSourcePixels = 100'000'000; ///< a picture with more is refused when its header says so
};

/// Decodes picture files. Any thread; a call waits for the file and takes as long as the decoding.
class ImageLoader {
public:
    virtual ~ImageLoader() = default;

    /// The picture in the file at a path, turned as its camera noted; of an animation the first frame.
    /// Errors: FileErrorCode::NoSuchFile, ImageErrorCode, or the system's error.
    virtual Result<Image> load(const std::string& path, const ImageLimits& limits) const = 0;
};

} // namespace platform
