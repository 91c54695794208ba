// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Url.h"

#include <string>

namespace host::drive {

/// The thumbnails of 1024 pixels in the desktop's shared thumbnail cache (its "xx-large" folder). A missing
/// one is made of a picture. Any thread, but not the main thread, because pictures are decoded at once.
class ThumbnailCache {
public:
    static constexpr int pixelSize = 1024;
    /// A picture with more pixels gets no thumbnail, because decoding it would take too much memory.
    static constexpr std::int64_t mostPixels = 100'000'000;

    enum class IfMissing { Nothing, MakeFromPicture };

    /// `folder` is the cache's root, `$XDG_CACHE_HOME/thumbnails`.
    explicit ThumbnailCache(std::string folder);
    /// Answers the cache's root in this environment.
    static std::string sharedFolder();

    /// Answers the thumbnails of a file's current version; empty when there are none.
    platform::ThumbnailMap thumbnails(
        const platform::Url& url, platform::Date modified, IfMissing ifMissing) const;

private:
    std::string _folder;
};

} // namespace host::drive
