// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Font.h"
#include "kit/values/PlatformNames.h"
#include "platform/Color.h"
#include "platform/Geometry.h"
#include "platform/Image.h"

#include <string_view>

namespace kit {

/// A slice of a disc. Angles are radians, 0 at three o'clock, growing clockwise on the screen.
struct Pie {
    Point center;
    double radius = 0;
    double startAngle = 0, endAngle = 0;
    bool operator==(const Pie&) const = default;
};

/// A surface for drawing, in the view's own coordinates. It is valid during the call that hands it out.
class Canvas {
public:
    virtual ~Canvas() = default;

    virtual void setFillColor(const Color& color) = 0;
    virtual void setStrokeColor(const Color& color) = 0;
    virtual void setLineWidth(double points) = 0; ///< 1 at first

    virtual void fillRect(const Rect& rect) = 0;
    virtual void strokeRect(const Rect& rect) = 0;
    virtual void fillEllipse(const Rect& inscribedIn) = 0;
    virtual void strokeEllipse(const Rect& inscribedIn) = 0;
    virtual void fillPie(const Pie& pie) = 0;
    virtual void strokeArc(const Pie& arc) = 0;
    virtual void drawImage(const Image& image, const Rect& rect) = 0;
    /// Draws one line in the fill colour. `origin` is the left end of the baseline.
    virtual void drawText(std::string_view text, const Font& font, Point origin) = 0;
};

} // namespace kit
