// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ColorBlending.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace tarrow {

using platform::Color;

namespace {

constexpr float epsilon = std::numeric_limits<float>::epsilon();

bool isNothing(double value)
{
    return std::abs(value) < epsilon;
}

float limited(float value)
{
    return std::clamp(value, 0.0F, 1.0F);
}

/// Answers a colour whose channels a function makes of the two colours' channels.
template <typename Channel>
Color combined(const Color& base, const Color& blend, float alpha, Channel channel)
{
    return {channel(base.red, blend.red), channel(base.green, blend.green), channel(base.blue, blend.blue),
        alpha};
}

// Terms that are written in double precision are rounded once, when they are complete.

Color coveredBy(const Color& base, const Color& blend)
{
    const double seenThrough = 1.0 - double{blend.alpha};
    const auto alpha = static_cast<float>(blend.alpha + base.alpha * seenThrough);
    if (isNothing(alpha))
        return Color::gray(1, alpha);
    return combined(base, blend, alpha, [&](float under, float over) {
        const double sum = double{blend.alpha} * over + seenThrough * base.alpha * under;
        return static_cast<float>(sum) / alpha;
    });
}

using Term = float (*)(float under, float over);

float screenTerm(float under, float over)
{
    return static_cast<float>(1.0 - (1.0 - over) * (1.0 - under));
}

float overlayTerm(float under, float over)
{
    return static_cast<float>(under < 0.5F ? 2.0 * over * under : 1.0 - 2.0 * (1.0 - under) * (1.0 - over));
}

float dodgeTerm(float under, float over)
{
    return isNothing(1.0 - over) ? 1.0F : static_cast<float>(under / (1.0 - over));
}

float burnTerm(float under, float over)
{
    return isNothing(over) ? 0.0F : static_cast<float>(1.0 - (1.0 - under) / over);
}

constexpr struct {
    std::string_view filter;
    Term term;
} separableBlends[] = {
    {compositingFilter::multiply, [](float under, float over) { return under * over; }},
    {compositingFilter::screen, screenTerm},
    {compositingFilter::overlay, overlayTerm},
    {compositingFilter::darken, [](float under, float over) { return std::min(under, over); }},
    {compositingFilter::lighten, [](float under, float over) { return std::max(under, over); }},
    {compositingFilter::colorDodge, dodgeTerm},
    {compositingFilter::plusLighter, [](float under, float over) { return std::min(1.0F, under + over); }},
};

/// Mixes what a term makes of the channels back into the base colour by the blend colour's opacity.
Color mixed(const Color& base, const Color& blend, Term term)
{
    return combined(base, blend, base.alpha,
        [&](float under, float over) { return blend.alpha * term(under, over) + (1 - blend.alpha) * under; });
}

Color burnt(const Color& base, const Color& blend)
{
    const Color premultiplied{
        base.red * base.alpha, base.green * base.alpha, base.blue * base.alpha, base.alpha};
    return mixed(premultiplied, blend, burnTerm);
}

Color addedDarker(const Color& base, const Color& blend)
{
    if (isNothing(base.alpha))
        return Color::gray(0, base.alpha);
    const float alpha = limited(base.alpha + blend.alpha);
    return combined(base, blend, base.alpha, [&](float under, float over) {
        if (isNothing(alpha))
            return 0.0F;
        const float missing = limited(blend.alpha - blend.alpha * over + base.alpha - under);
        return limited(alpha - missing / base.alpha);
    });
}

} // namespace

inline namespace TarrowDriveApp_FileTagColors {

Color trw_colorBlendedWithColorCompositingFilter(
    const Color& base, const std::optional<Color>& blend, std::optional<std::string_view> filter)
{
    if (!blend || isNothing(blend->alpha))
        return base;
    if (!filter || *filter == compositingFilter::normal || *filter == compositingFilter::sourceOver)
        return coveredBy(base, *blend);
    for (const auto& separable : separableBlends) {
        if (*filter == separable.filter)
            return mixed(base, *blend, separable.term);
    }
    if (*filter == compositingFilter::colorBurn)
        return burnt(base, *blend);
    return *filter == compositingFilter::plusDarker ? addedDarker(base, *blend) : base;
}

Color trw_colorBlendedWithColor(const Color& base, const std::optional<Color>& blend)
{
    return trw_colorBlendedWithColorCompositingFilter(base, blend, compositingFilter::sourceOver);
}

} // namespace TarrowDriveApp_FileTagColors

} // namespace tarrow
