// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/ThemedCanvas.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/base/TextLayout.h"

namespace host::gtk {

ThemedCanvas::ThemedCanvas(cairo_t* cairo, const Theme& theme)
    : CairoCanvas(cairo)
    , _theme(theme)
{
}

void ThemedCanvas::use(const platform::Color& color)
{
    const GdkRGBA shown = _theme.resolve(color, ColorUse::Content);
    gdk_cairo_set_source_rgba(cairo(), &shown);
}

void ThemedCanvas::drawImage(const platform::Image& image, const platform::Rect& rect)
{
    ImagePaint::draw(cairo(), image, rect);
}

void ThemedCanvas::drawText(std::string_view text, const kit::Font& font, platform::Point origin)
{
    const auto layout = TextLayout::make(_theme.makePangoContext().get(), text,
        TextLayout::attributes(_theme, font, nullptr), kit::TextLimits());
    use(fillColor());
    const double baseline = static_cast<double>(pango_layout_get_baseline(layout.get())) / PANGO_SCALE;
    cairo_save(cairo());
    cairo_translate(cairo(), origin.x, origin.y - baseline);
    TextLayout::draw(cairo(), layout.get());
    cairo_restore(cairo());
}

} // namespace host::gtk
