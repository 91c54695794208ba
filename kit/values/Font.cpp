// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/Font.h"

#include "kit/values/TextMeasurer.h"

#include <array>

namespace kit {

Font Font::preferred(TextStyle style)
{
    // The platform's sizes at the default text-size setting, in the order of TextStyle.
    static constexpr std::array<double, 11> sizes{34, 28, 22, 20, 17, 15, 17, 16, 13, 12, 11};
    const auto weight = style == TextStyle::Headline ? FontWeight::Bold : FontWeight::Regular;
    return {style, sizes[static_cast<std::size_t>(style)], weight, TextSizing::FollowsSetting};
}

Font Font::preferred(TextStyle style, double pointSize)
{
    Font font = preferred(style);
    font.pointSize = pointSize;
    return font;
}

Font Font::bold() const
{
    Font font = *this;
    font.weight = FontWeight::Bold;
    return font;
}

Font Font::fixed() const
{
    Font font = *this;
    font.sizing = TextSizing::Fixed;
    return font;
}

FontMetrics Font::metrics() const
{
    return TextMeasurer::current().metrics(*this);
}

} // namespace kit
