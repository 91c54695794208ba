// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Font.h"
#include "kit/values/PlatformNames.h"
#include "platform/Color.h"
#include "platform/Image.h"

#include <optional>
#include <string>
#include <vector>

namespace kit {

/// Says how one piece of a styled text is set. The label that shows the text gives the absent values.
struct TextAttributes {
    std::optional<Font> font;
    std::optional<Color> color;
    double baselineOffset = 0; ///< points above the baseline

    bool operator==(const TextAttributes&) const = default;
};

/// A piece of a styled text: either characters or one image.
struct TextRun {
    std::string text;
    std::optional<Image> attachment;
    TextAttributes attributes;

    bool operator==(const TextRun&) const = default;
};

/// Text whose pieces have fonts, colours and images of their own.
class AttributedText {
public:
    AttributedText() = default;
    explicit AttributedText(std::string text, TextAttributes attributes = {});

    void append(std::string text, TextAttributes attributes = {});
    void append(Image attachment, TextAttributes attributes = {});

    const std::vector<TextRun>& runs() const { return _runs; }
    bool isEmpty() const { return _runs.empty(); }
    /// Answers the characters alone, without the images.
    std::string plainText() const;

    bool operator==(const AttributedText&) const = default;

private:
    std::vector<TextRun> _runs;
};

} // namespace kit
