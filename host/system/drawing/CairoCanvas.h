// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Canvas.h"

#include <cairo.h>

namespace host::system {

/// Draws on a Cairo context that its owner keeps, without a window: colours are drawn as they are, a named
/// icon is left out, and texts have the system's plain typeface. It belongs to one thread, which may be any.
class CairoCanvas : public kit::Canvas {
public:
    /// Sets the context's line width to one point; the rest of the context's state is used as it is.
    explicit CairoCanvas(cairo_t* cairo);

    void setFillColor(const platform::Color& color) override { _fill = color; }
    void setStrokeColor(const platform::Color& color) override { _stroke = color; }
    void setLineWidth(double points) override;
    void fillRect(const platform::Rect& rect) override;
    void strokeRect(const platform::Rect& rect) override;
    void fillEllipse(const platform::Rect& inscribedIn) override;
    void strokeEllipse(const platform::Rect& inscribedIn) override;
    void fillPie(const kit::Pie& pie) override;
    void strokeArc(const kit::Pie& arc) override;
    void drawImage(const platform::Image& image, const platform::Rect& rect) override;
    void drawText(std::string_view text, const kit::Font& font, platform::Point origin) override;

    /// Draws an image's pixels scaled into a rectangle; nothing for an image or a rectangle without any.
    static void drawPixels(
        cairo_t* cairo, const platform::Image& image, const platform::Rect& rect, cairo_filter_t filter);

protected:
    /// Makes a colour the context's source. A canvas of a window answers its theme's colours here.
    virtual void use(const platform::Color& color);

    cairo_t* cairo() const { return _cairo; }
    const platform::Color& fillColor() const { return _fill; }

private:
    void fill();
    void stroke();
    void ellipse(const platform::Rect& inscribedIn);

    cairo_t* _cairo;
    platform::Color _fill = platform::Color::black(), _stroke = platform::Color::black();
};

} // namespace host::system
