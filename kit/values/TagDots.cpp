// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TagDots.h"

#include "kit/values/Canvas.h"

#include <cmath>

namespace kit::TagDots {

namespace {

double step(double height)
{
    return height * 0.5;
}

} // namespace

Size size(std::size_t count, double height)
{
    if (count == 0)
        return {};
    const double diameter = std::ceil(height);
    return {diameter + step(height) * static_cast<double>(count - 1), diameter};
}

void draw(Canvas& canvas, const std::vector<TagDot>& dots, double height)
{
    // Half of the rim lies outside the circle that it follows.
    constexpr double rimWidth = 1, inset = rimWidth / 2;
    const double inner = std::ceil(height) - 2 * inset;
    double left = 0;
    canvas.setLineWidth(rimWidth);
    for (const auto& dot : dots) {
        const Rect circle{left + inset, inset, inner, inner};
        canvas.setFillColor(dot.fill);
        canvas.fillEllipse(circle);
        canvas.setStrokeColor(dot.rim);
        canvas.strokeEllipse(circle);
        left += step(height);
    }
}

} // namespace kit::TagDots
