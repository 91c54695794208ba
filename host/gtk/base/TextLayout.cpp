// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/TextLayout.h"

#include "host/gtk/base/ImagePaint.h"

#include <algorithm>
#include <cmath>
#include <memory>

namespace host::gtk::TextLayout {

using kit::AttributedText;
using kit::Font;
using kit::TextRun;
using platform::Image;

namespace {

constexpr std::string_view objectReplacement = "\xEF\xBF\xBC";

void insert(PangoAttrList* list, PangoAttribute* attribute, std::size_t start, std::size_t end)
{
    attribute->start_index = static_cast<guint>(start);
    attribute->end_index = static_cast<guint>(end);
    pango_attr_list_insert(list, attribute);
}

void insertColor(PangoAttrList* list, const GdkRGBA& color, std::size_t start, std::size_t end)
{
    const auto component = [](float value) { return static_cast<guint16>(std::lround(value * 65535)); };
    insert(list,
        pango_attr_foreground_new(component(color.red), component(color.green), component(color.blue)), start,
        end);
    insert(list, pango_attr_foreground_alpha_new(component(color.alpha)), start, end);
}

platform::Size attachmentSize(const Image& image, const Theme& theme, const Font& font)
{
    if (!image.isNamed() || image.size().width > 0)
        return image.size();
    const auto description = theme.describe(font);
    const double side = static_cast<double>(pango_font_description_get_size(description.get())) / PANGO_SCALE;
    return {side, side};
}

void insertShape(PangoAttrList* list, const TextRun& run, platform::Size size, std::size_t start)
{
    const auto units = [](double points) { return static_cast<int>(std::lround(points * PANGO_SCALE)); };
    const PangoRectangle rect{
        0, units(-size.height - run.attributes.baselineOffset), units(size.width), units(size.height)};
    auto* attribute = pango_attr_shape_new_with_data(
        &rect, &rect, new Image(*run.attachment),
        [](gconstpointer image) -> gpointer { return new Image(*static_cast<const Image*>(image)); },
        [](gpointer image) { delete static_cast<Image*>(image); });
    insert(list, attribute, start, start + objectReplacement.size());
}

void drawShape(cairo_t* cairo, PangoAttrShape* shape, gboolean onlyPath, gpointer)
{
    if (onlyPath || !shape->data)
        return;
    double x = 0, y = 0;
    cairo_get_current_point(cairo, &x, &y);
    const auto points = [](int units) { return static_cast<double>(units) / PANGO_SCALE; };
    ImagePaint::draw(cairo, *static_cast<const Image*>(shape->data),
        {x + points(shape->ink_rect.x), y + points(shape->ink_rect.y), points(shape->ink_rect.width),
            points(shape->ink_rect.height)});
}

void insertRun(PangoAttrList* list, const Theme& theme, const TextRun& run, const Font& fallback,
    std::size_t start, std::size_t end)
{
    const Font& font = run.attributes.font.value_or(fallback);
    insert(list, pango_attr_font_desc_new(theme.describe(font).get()), start, end);
    if (run.attachment) {
        insertShape(list, run, attachmentSize(*run.attachment, theme, font), start);
        return;
    }
    if (run.attributes.color && !(*run.attributes.color == platform::Color::black()))
        insertColor(list, theme.resolve(*run.attributes.color, ColorUse::Content), start, end);
    if (run.attributes.baselineOffset != 0) {
        const int rise = static_cast<int>(std::lround(run.attributes.baselineOffset * PANGO_SCALE));
        insert(list, pango_attr_rise_new(rise), start, end);
    }
}

} // namespace

Attributes attributes(const Theme& theme, const Font& font, const platform::Color* color)
{
    Attributes list(pango_attr_list_new(), &pango_attr_list_unref);
    insert(list.get(), pango_attr_font_desc_new(theme.describe(font).get()), 0, G_MAXUINT);
    // A broken name must not look as if it contained hyphens.
    insert(list.get(), pango_attr_insert_hyphens_new(FALSE), 0, G_MAXUINT);
    if (color && !(*color == platform::Color::black()))
        insertColor(list.get(), theme.resolve(*color, ColorUse::Content), 0, G_MAXUINT);
    return list;
}

Attributes attributes(const Theme& theme, const AttributedText& text, const Font& font)
{
    Attributes list = attributes(theme, font, nullptr);
    std::size_t start = 0;
    for (const auto& run : text.runs()) {
        const std::size_t length = run.attachment ? objectReplacement.size() : run.text.size();
        insertRun(list.get(), theme, run, font, start, start + length);
        start += length;
    }
    return list;
}

std::string text(const AttributedText& text)
{
    std::string characters;
    for (const auto& run : text.runs())
        characters += run.attachment ? objectReplacement : std::string_view(run.text);
    return characters;
}

bool hasAttachments(const AttributedText& text)
{
    return std::ranges::any_of(text.runs(), [](const TextRun& run) { return run.attachment.has_value(); });
}

ObjectRef<PangoLayout> make(
    PangoContext* context, std::string_view characters, Attributes attributes, const kit::TextLimits& limits)
{
    auto layout = ObjectRef<PangoLayout>::adopt(pango_layout_new(context));
    pango_layout_set_text(layout.get(), characters.data(), static_cast<int>(characters.size()));
    pango_layout_set_attributes(layout.get(), attributes.get());
    if (limits.maxWidth > 0) {
        pango_layout_set_width(layout.get(), static_cast<int>(limits.maxWidth * PANGO_SCALE));
        pango_layout_set_wrap(layout.get(), PANGO_WRAP_WORD_CHAR);
    }
    if (limits.maxLines > 0) {
        pango_layout_set_height(layout.get(), -limits.maxLines);
        pango_layout_set_ellipsize(layout.get(), PANGO_ELLIPSIZE_END);
    }
    return layout;
}

void draw(cairo_t* cairo, PangoLayout* layout)
{
    pango_cairo_context_set_shape_renderer(pango_layout_get_context(layout), drawShape, nullptr, nullptr);
    pango_cairo_update_layout(cairo, layout);
    pango_cairo_show_layout(cairo, layout);
}

} // namespace host::gtk::TextLayout
