// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/Theme.h"
#include "kit/values/Canvas.h"

#include <cairo.h>

namespace host::gtk {

/// The canvas into which a view draws while its widget is painted.
class CairoCanvas : public kit::Canvas {
public:
    CairoCanvas(cairo_t* cairo, const Theme& theme);

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

private:
    void fill();
    void stroke();
    void use(const platform::Color& color);
    void ellipse(const platform::Rect& inscribedIn);

    cairo_t* _cairo;
    const Theme& _theme;
    platform::Color _fill = platform::Color::black(), _stroke = platform::Color::black();
};

} // namespace host::gtk
