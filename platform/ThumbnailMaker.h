// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Image.h"

#include <cstdint>
#include <string>

namespace platform {

/// What a document's thumbnail is made of.
enum class ThumbnailContent : std::uint8_t {
    None, ///< nothing that can be shown small, or nothing that is here
    Picture,
    Pages, ///< the first page of a document of pages
    Film, ///< a frame from the beginning of a film
};

/// Makes thumbnails of the documents that need large libraries: pages and films. Any thread may call, and
/// several calls may run at once; each takes as long as its work, so it is not for the main thread.
class ThumbnailMaker {
public:
    virtual ~ThumbnailMaker() = default;

    /// Answers a picture of the document in the file at a path, which must be a regular file. Its longer side
    /// has `pixelSize` pixels, of a smaller film fewer. Only this file is read, whatever others it names. A
    /// film gets a few seconds. Errors: those of PagedDocumentOpener::open(); for a film
    /// ImageErrorCode::Damaged, also when it has very large frames, or the system's error when it takes too
    /// long or this machine lacks what such a film needs. Content of any other kind is
    /// ImageErrorCode::Damaged.
    virtual Result<Image> makeThumbnail(
        const std::string& path, ThumbnailContent content, int pixelSize) const = 0;
};

} // namespace platform
