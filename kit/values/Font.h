// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

enum class TextStyle {
    LargeTitle,
    Title1,
    Title2,
    Title3,
    Headline,
    Subheadline,
    Body,
    Callout,
    Footnote,
    Caption1,
    Caption2,
};

enum class FontWeight { Regular, Bold };

/// Says whether a font grows and shrinks with the user's text-size setting.
enum class TextSizing { FollowsSetting, Fixed };

/// Lengths of a font in points, measured from the baseline. A length below the baseline is negative.
struct FontMetrics {
    double ascender = 0, descender = 0, capHeight = 0, lineHeight = 0;
};

/// A font, named by the role that its text plays.
struct Font {
    TextStyle style = TextStyle::Body;
    double pointSize = 17; ///< at the default text size
    FontWeight weight = FontWeight::Regular;
    TextSizing sizing = TextSizing::FollowsSetting;

    /// Answers the role's font in its standard size and weight.
    static Font preferred(TextStyle style);
    static Font preferred(TextStyle style, double pointSize);

    Font bold() const;
    Font fixed() const;

    /// Answers the metrics as the installed text measurer knows them.
    FontMetrics metrics() const;
    double lineHeight() const { return metrics().lineHeight; }

    bool operator==(const Font&) const = default;
};

} // namespace kit
