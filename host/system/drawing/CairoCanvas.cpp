// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/drawing/CairoCanvas.h"

#include <pango/pangocairo.h>

#include <memory>
#include <numbers>

namespace host::system {

using platform::Rect;

namespace {

struct Unref {
    void operator()(gpointer object) const { g_object_unref(object); }
};

std::unique_ptr<PangoLayout, Unref> layoutOf(cairo_t* cairo, std::string_view text, const kit::Font& font)
{
    std::unique_ptr<PangoLayout, Unref> layout(pango_cairo_create_layout(cairo));
    const std::unique_ptr<PangoFontDescription, decltype(&pango_font_description_free)> description(
        pango_font_description_new(), &pango_font_description_free);
    pango_font_description_set_family(description.get(), "Sans");
    pango_font_description_set_absolute_size(description.get(), font.pointSize * PANGO_SCALE);
    if (font.weight == kit::FontWeight::Bold)
        pango_font_description_set_weight(description.get(), PANGO_WEIGHT_BOLD);
    pango_layout_set_font_description(layout.get(), description.get());
    pango_layout_set_single_paragraph_mode(layout.get(), TRUE);
    pango_layout_set_text(layout.get(), text.data(), static_cast<int>(text.size()));
    return layout;
}

} // namespace

CairoCanvas::CairoCanvas(cairo_t* cairo)
    : _cairo(cairo)
{
    cairo_set_line_width(cairo, 1);
}

void CairoCanvas::setLineWidth(double points)
{
    cairo_set_line_width(_cairo, points);
}

void CairoCanvas::use(const platform::Color& color)
{
    cairo_set_source_rgba(_cairo, color.red, color.green, color.blue, color.alpha);
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
    drawPixels(_cairo, image, rect, CAIRO_FILTER_GOOD);
}

void CairoCanvas::drawPixels(
    cairo_t* cairo, const platform::Image& image, const Rect& rect, cairo_filter_t filter)
{
    if (image.pixels().empty() || rect.width <= 0 || rect.height <= 0)
        return;
    // The cast is safe, because Cairo only reads a surface that is used as a source.
    auto* pixels = reinterpret_cast<unsigned char*>(const_cast<std::uint32_t*>(image.pixels().data()));
    auto* surface = cairo_image_surface_create_for_data(
        pixels, CAIRO_FORMAT_ARGB32, image.pixelWidth(), image.pixelHeight(), image.pixelWidth() * 4);
    cairo_save(cairo);
    cairo_translate(cairo, rect.x, rect.y);
    cairo_scale(cairo, rect.width / image.pixelWidth(), rect.height / image.pixelHeight());
    cairo_set_source_surface(cairo, surface, 0, 0);
    cairo_pattern_set_filter(cairo_get_source(cairo), filter);
    cairo_paint(cairo);
    cairo_restore(cairo);
    cairo_surface_destroy(surface);
}

void CairoCanvas::drawText(std::string_view text, const kit::Font& font, platform::Point origin)
{
    const auto layout = layoutOf(_cairo, text, font);
    const double baseline = static_cast<double>(pango_layout_get_baseline(layout.get())) / PANGO_SCALE;
    use(_fill);
    cairo_save(_cairo);
    cairo_move_to(_cairo, origin.x, origin.y - baseline);
    pango_cairo_show_layout(_cairo, layout.get());
    cairo_restore(_cairo);
}

} // namespace host::system
