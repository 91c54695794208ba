// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewContent.h"

#include <cstddef>
#include <functional>

namespace screens {

/// How much of a document a preview reads.
struct PreviewLimits {
    int maxImageWidth = 4096, maxImageHeight = 4096; ///< pixels; larger pictures are shown smaller
    std::uint64_t maxImagePixels = 0; ///< in all; 0: as the sides allow
    double imageScale = 1; ///< pixels to a point
    std::size_t maxTextBytes = 1 << 20; ///< what is beyond is cut off, and the note says so
    std::size_t maxLineBytes = 4 << 10; ///< a longer line is cut off, and the note says so
};

/// What fills the main screen, and not more. Main thread.
PreviewLimits previewLimitsForMainScreen();
/// For a closer look at a picture: 24 million pixels.
PreviewLimits previewLimitsForCloseLook();

/// Reads what a preview shows of a document, never fetching one that is not downloaded. Nothing but regular
/// files is opened. Pictures of more than 100 million pixels or 256 MiB are refused, animations move up to 64
/// MiB of frames, and of a text the first MiB is read (see ImageLimits and PreviewLimits). It takes as long
/// as the reading; any thread. `isCancelled` is asked between the steps; after it answered true the content
/// means nothing.
PreviewContent loadPreview(
    const Url& url, const PreviewLimits& limits, const std::function<bool()>& isCancelled = {});

} // namespace screens
