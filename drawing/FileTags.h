// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/TagDots.h"
#include "platform/Color.h"
#include "platform/Geometry.h"
#include "platform/Image.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tarrow {

/// The tags that the account's devices share: their names in the user's order, their colours, and the dots
/// that stand for them. The table is read at the first question, and again whenever the key-value store says
/// that it has changed; nobody else is told of such a change. Any thread, also for the first question: the
/// first of several that come at once reads the table, and the others wait for it.
class FileTags {
public:
    using ColorsByTag = std::map<std::string, platform::Color, std::less<>>;

    FileTags() = delete;

    /// Answers the colour of one tag without copying the table, and nothing for a name that it does not hold.
    static std::optional<platform::Color> colorOfTag(std::string_view name);
    /// Answers a copy of the table's colours. A name that occurs twice in the table has the later colour.
    static ColorsByTag tagColorsByTag();
    /// Answers a copy of the table's names in its order; a name that occurs twice is answered twice.
    static std::vector<std::string> allTags();

    /// Answers an image of dots that overlap, one for each name in this order, or nothing for no names. The
    /// dots are as high as the next whole number of points, each lies half a height beside the one before it
    /// and covers it, and each has a lighter rim. `scale` is the image's number of pixels to a point. Answers
    /// nothing for a height or a scale that leaves no pixel, either.
    static std::optional<platform::Image> blipWithTagsHeightScale(
        const std::vector<std::string>& tags, float height, float scale);
    /// Answers an image of so many points, with one pixel to each, in which a dot without a rim lies with the
    /// top left corner of its square at the offset; nothing without a name, and for a size without a pixel.
    static std::optional<platform::Image> blipWithTagImageSizeBlipHeightOffset(
        const std::optional<std::string>& tag, platform::Size imageSize, float blipHeight,
        platform::Point offset);
    /// Answers the dots of blipWithTagsHeightScale() for those who draw them themselves, such as the rows of
    /// a list. A tag that the table does not hold has the colour of a tag without one.
    static std::vector<kit::TagDot> dotsForTags(const std::vector<std::string>& tags);

    /// Answers the colours from which a table's entries choose by their index; 0 means a tag without a
    /// colour.
    static const std::array<platform::Color, 8>& _tagBlipColors();
    /// Reads the table from the key-value store, one thread after another. A table whose version is not 2
    /// counts as empty. An entry without a name is left out, and an index beyond the colours counts as 0.
    static void _tagColorsDidChange();
};

} // namespace tarrow
