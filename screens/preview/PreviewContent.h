// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileChanges.h"
#include "platform/Geometry.h"
#include "platform/ImageLoader.h"
#include "platform/PagedDocument.h"
#include "screens/PlatformNames.h"

#include <memory>
#include <optional>
#include <string>

namespace screens {

/// The content of a document's preview, ready to be put on the screen. A value.
struct PreviewContent {
    enum class Kind {
        Image, ///< `picture`
        Text, ///< `text`
        Pages, ///< `pages`
        Sound, ///< a sound file at `path`
        Film, ///< a film at `path`
        Summary, ///< icon, title and note (kind and size), because the type has no view
        InCloud, ///< a Summary of a document that is not downloaded
        Failure, ///< `note` says why nothing can be shown
    };

    Kind kind = Kind::Summary;
    Picture picture;
    std::string text;
    bool isSource = false; ///< the text is source code, which has colours and letters of one width
    std::shared_ptr<PagedDocument> pages;
    Size firstPage; ///< of Pages; page points
    PagesRights rights; ///< of Pages
    std::optional<ItemVersion> version; ///< of Pages: the version that was read
    std::string path, fileName;
    std::string iconName, title;
    std::string note; ///< of a Text or an Image: says which part is left out
    bool canRetry = false; ///< of a Failure: trying again may help
};

} // namespace screens
