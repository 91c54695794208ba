// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Color.h"
#include "platform/Geometry.h"

#include <cstddef>
#include <vector>

namespace kit {

class Canvas;

/// A dot that stands for one of an item's tags.
struct TagDot {
    Color fill;
    Color rim; ///< the colour of its edge, one point wide
    bool operator==(const TagDot&) const = default;
};

/// The dots of an item's tags side by side, wherever they are shown. Each covers the right half of the one
/// before it. A height in points is given for each use; the dots are as high as its next whole number.
namespace TagDots {

/// Answers the room that so many dots take, in points; nothing for none.
Size size(std::size_t count, double height);
/// Draws dots with the top left corner of the first one at (0, 0).
void draw(Canvas& canvas, const std::vector<TagDot>& dots, double height);

} // namespace TagDots

} // namespace kit
