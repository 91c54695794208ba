#pragma once

#include "platform/Image.h"

#include <optional>
#include <string>

namespace platform::components {

/// What a preview shows of a document, ready to be put on the screen. A value.
struct PreviewContent {
    enum class Kind {
        Image, ///< `image`
        Text, ///< `text`, with `note` when it was cut
        Summary, ///< icon, title and note (kind and size): there is no view for its type
        InCloud, ///< as Summary, and `note` says that it is not downloaded
        Failure, ///< `note` says why nothing can be shown
    };

    Kind kind = Kind::Summary;
    std::optional<Image> image;
    std::string text;
    bool isMonospaced = false;
    std::string iconName, title, note;
};

} // namespace platform::components
