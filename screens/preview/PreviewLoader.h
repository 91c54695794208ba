// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewContent.h"

#include <cstddef>
#include <functional>

namespace screens {

/// The limits within which a preview reads a document.
struct PreviewLimits {
    int maxImageWidth = 4096, maxImageHeight = 4096; ///< pixels; larger pictures are shown smaller
    std::uint64_t maxImagePixels = 0; ///< all pixels together; 0: no limit but the sides
    double imageScale = 1; ///< pixels to a point
    std::size_t maxTextBytes = 1 << 20; ///< a longer text is cut off, and the note says so
    std::size_t maxLineBytes = 4 << 10; ///< a longer line is cut off, and the note says so
};

/// Answers limits that fill the main screen. Main thread.
PreviewLimits previewLimitsForMainScreen();
/// Answers limits for a closer look at a picture: 24 million pixels.
PreviewLimits previewLimitsForCloseLook();

/// Reads the content of a document's preview. It never downloads a document, and opens regular files only.
/// It refuses pictures of more than 100 million pixels (photos that are made smaller while they are read: of
/// more than 1,000 million) or 256 MiB, shows the frames of an animation up to 64
/// MiB, and reads the first MiB of a text (see ImageLimits and PreviewLimits). It blocks while it reads; any
/// thread. `isCancelled` is asked between the steps; when it has answered true, the content must not be used.
PreviewContent loadPreview(
    const Url& url, const PreviewLimits& limits, const std::function<bool()>& isCancelled = {});

} // namespace screens
