// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/PangoTextMeasurer.h"

#include "host/gtk/base/TextLayout.h"

#include <cmath>

namespace host::gtk {

using kit::Font;
using kit::FontMetrics;
using kit::TextLimits;
using platform::Size;

namespace {

double points(int units)
{
    return static_cast<double>(units) / PANGO_SCALE;
}

/// Rounds up to whole points, because widgets have whole sizes.
Size sizeOf(PangoLayout* layout)
{
    PangoRectangle logical;
    pango_layout_get_extents(layout, nullptr, &logical);
    return {std::ceil(points(logical.width)), std::ceil(points(logical.height))};
}

} // namespace

PangoTextMeasurer::PangoTextMeasurer(std::shared_ptr<const Theme> theme)
    : _theme(std::move(theme))
{
}

PangoContext* PangoTextMeasurer::context() const
{
    if (!_context)
        _context = _theme->makePangoContext();
    return _context.get();
}

void PangoTextMeasurer::themeDidChange()
{
    _context.reset();
}

Size PangoTextMeasurer::measure(std::string_view text, const Font& font, const TextLimits& limits) const
{
    return sizeOf(
        TextLayout::make(context(), text, TextLayout::attributes(*_theme, font, nullptr), limits).get());
}

Size PangoTextMeasurer::measure(
    const kit::AttributedText& text, const Font& font, const TextLimits& limits) const
{
    return sizeOf(TextLayout::make(
        context(), TextLayout::text(text), TextLayout::attributes(*_theme, text, font), limits)
                      .get());
}

FontMetrics PangoTextMeasurer::metrics(const Font& font) const
{
    const auto description = _theme->describe(font);
    auto* found = pango_context_get_metrics(context(), description.get(), nullptr);
    FontMetrics metrics;
    metrics.ascender = points(pango_font_metrics_get_ascent(found));
    metrics.descender = -points(pango_font_metrics_get_descent(found));
    metrics.lineHeight = points(pango_font_metrics_get_height(found));
    if (metrics.lineHeight <= 0)
        metrics.lineHeight = metrics.ascender - metrics.descender;
    pango_font_metrics_unref(found);
    PangoRectangle ink;
    const auto capital =
        TextLayout::make(context(), "H", TextLayout::attributes(*_theme, font, nullptr), TextLimits());
    pango_layout_get_extents(capital.get(), &ink, nullptr);
    metrics.capHeight = points(ink.height);
    return metrics;
}

} // namespace host::gtk
