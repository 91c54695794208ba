// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/AttributedText.h"
#include "kit/values/Font.h"
#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <memory>
#include <string_view>

namespace kit {

/// The room that a text may take.
struct TextLimits {
    double maxWidth = 0; ///< points; 0 or less: as wide as it gets, one line per paragraph
    int maxLines = 0; ///< 0: as many as it takes
};

/// Measures text for the layout. The host installs one that knows the real fonts; without it a plain measurer
/// that takes every character as 0.5 and every line as 1.2 times the point size keeps layouts predictable.
/// Main thread only.
class TextMeasurer {
public:
    virtual ~TextMeasurer() = default;

    /// Answers the size of a text in points, wrapped at word boundaries.
    virtual Size measure(std::string_view text, const Font& font, const TextLimits& limits) const = 0;
    /// Pieces of the text that name no font are measured in `font`.
    virtual Size measure(const AttributedText& text, const Font& font, const TextLimits& limits) const = 0;
    virtual FontMetrics metrics(const Font& font) const = 0;

    static const TextMeasurer& current();
    /// Installs a measurer; null installs the plain one again. Views that were laid out before keep their
    /// sizes until they change.
    static void install(std::shared_ptr<const TextMeasurer> measurer);
};

} // namespace kit
