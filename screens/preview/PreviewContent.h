// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileSystem.h"
#include "platform/Geometry.h"
#include "platform/ImageLoader.h"
#include "platform/PagedDocument.h"
#include "screens/PlatformNames.h"

#include <memory>
#include <optional>
#include <string>

namespace screens {

/// What a preview shows of a document, ready to be put on the screen. A value.
struct PreviewContent {
    enum class Kind {
        Image, ///< `picture`
        Text, ///< `text`
        Pages, ///< `pages`
        Sound, ///< what lies at `path`
        Film, ///< what lies at `path`
        Summary, ///< icon, title and note (kind and size): there is no view for its type
        InCloud, ///< as Summary: it is not downloaded
        Failure, ///< `note` says why nothing can be shown
    };

    Kind kind = Kind::Summary;
    Picture picture;
    std::string text;
    bool isSource = false; ///< of a text: it has a language of its own, and letters of one width
    std::shared_ptr<PagedDocument> pages;
    Size firstPage; ///< of pages, their own points
    PagesRights rights; ///< of pages
    std::optional<ItemVersion> version; ///< of pages: what was read
    std::string path, fileName;
    std::string iconName, title;
    std::string note; ///< of a text or a picture: what is left out of it
    bool canRetry = false; ///< of a failure: trying again may help
};

} // namespace screens
