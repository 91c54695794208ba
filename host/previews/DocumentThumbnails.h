// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/ThumbnailMaker.h"

namespace host::previews {

/// Makes thumbnails with the libraries of the previews: of pages with Poppler, of films with GStreamer.
class DocumentThumbnails : public platform::ThumbnailMaker {
public:
    platform::Result<platform::Image> makeThumbnail(
        const std::string& path, platform::ThumbnailContent content, int pixelSize) const override;
};

} // namespace host::previews
