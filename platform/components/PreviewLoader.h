#pragma once

#include "platform/Url.h"
#include "platform/components/PreviewContent.h"

#include <cstddef>

namespace platform::components {

/// How much of a document a preview reads.
struct PreviewLimits {
    int maxImageWidth = 4096, maxImageHeight = 4096; ///< pixels; larger pictures are shown smaller
    double imageScale = 1; ///< pixels to a point
    std::size_t maxTextBytes = 1 << 20; ///< what is beyond is cut off, and the note says so
};

/// The limits for the main screen: pictures of at most twice as many pixels on each side. Main thread.
PreviewLimits previewLimitsForMainScreen();

/// Reads what a preview shows of a document, never fetching one that is not downloaded. Takes as long as the
/// reading; any thread.
PreviewContent loadPreview(const Url& url, const PreviewLimits& limits);

} // namespace platform::components
