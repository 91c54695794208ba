// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/CairoCanvas.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/base/TextLayout.h"

#include <numbers>

namespace host::gtk {

using platform::Rect;

CairoCanvas::CairoCanvas(cairo_t* cairo, const Theme& theme)
    : _cairo(cairo)
    , _theme(theme)
{
    cairo_set_line_width(cairo, 1);
}

void CairoCanvas::setLineWidth(double points)
{
    cairo_set_line_width(_cairo, points);
}

void CairoCanvas::use(const platform::Color& color)
{
    const GdkRGBA shown = _theme.resolve(color, ColorUse::Content);
    gdk_cairo_set_source_rgba(_cairo, &shown);
}

void CairoCanvas::fill()
{
    use(_fill);
    cairo_fill(_cairo);
}

void CairoCanvas::stroke()
{
    use(_stroke);
    cairo_stroke(_cairo);
}

void CairoCanvas::ellipse(const Rect& inscribedIn)
{
    cairo_new_path(_cairo);
    if (inscribedIn.width <= 0 || inscribedIn.height <= 0)
        return;
    cairo_save(_cairo);
    cairo_translate(_cairo, inscribedIn.midX(), inscribedIn.midY());
    cairo_scale(_cairo, inscribedIn.width / 2, inscribedIn.height / 2);
    cairo_arc(_cairo, 0, 0, 1, 0, 2 * std::numbers::pi);
    cairo_restore(_cairo);
}

void CairoCanvas::fillRect(const Rect& rect)
{
    cairo_rectangle(_cairo, rect.x, rect.y, rect.width, rect.height);
    fill();
}

void CairoCanvas::strokeRect(const Rect& rect)
{
    cairo_rectangle(_cairo, rect.x, rect.y, rect.width, rect.height);
    stroke();
}

void CairoCanvas::fillEllipse(const Rect& inscribedIn)
{
    ellipse(inscribedIn);
    fill();
}

void CairoCanvas::strokeEllipse(const Rect& inscribedIn)
{
    ellipse(inscribedIn);
    stroke();
}

void CairoCanvas::fillPie(const kit::Pie& pie)
{
    cairo_move_to(_cairo, pie.center.x, pie.center.y);
    cairo_arc(_cairo, pie.center.x, pie.center.y, pie.radius, pie.startAngle, pie.endAngle);
    cairo_close_path(_cairo);
    fill();
}

void CairoCanvas::strokeArc(const kit::Pie& arc)
{
    cairo_new_path(_cairo);
    cairo_arc(_cairo, arc.center.x, arc.center.y, arc.radius, arc.startAngle, arc.endAngle);
    stroke();
}

void CairoCanvas::drawImage(const platform::Image& image, const Rect& rect)
{
    ImagePaint::draw(_cairo, image, rect);
}

void CairoCanvas::drawText(std::string_view text, const kit::Font& font, platform::Point origin)
{
    const auto layout = TextLayout::make(_theme.makePangoContext().get(), text,
        TextLayout::attributes(_theme, font, nullptr), kit::TextLimits());
    use(_fill);
    const double baseline = static_cast<double>(pango_layout_get_baseline(layout.get())) / PANGO_SCALE;
    cairo_save(_cairo);
    cairo_translate(_cairo, origin.x, origin.y - baseline);
    TextLayout::draw(_cairo, layout.get());
    cairo_restore(_cairo);
}

} // namespace host::gtk
