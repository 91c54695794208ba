// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/Theme.h"
#include "kit/values/AttributedText.h"
#include "kit/values/TextMeasurer.h"

#include <pango/pangocairo.h>

#include <memory>
#include <string_view>

namespace host::gtk {

/// Pango's view of the kit's texts, the same for measuring and for showing.
namespace TextLayout {

using Attributes = std::unique_ptr<PangoAttrList, decltype(&pango_attr_list_unref)>;

/// Font and, when there is one, colour over a whole text.
Attributes attributes(const Theme& theme, const kit::Font& font, const platform::Color* color);
/// Of a styled text whose pieces fall back on `font`. The byte offsets are those of `text(...)`.
Attributes attributes(
    const Theme& theme, const kit::AttributedText& text, const kit::Font& font);
/// The characters, with one object replacement character for each image.
std::string text(const kit::AttributedText& text);
bool hasAttachments(const kit::AttributedText& text);

ObjectRef<PangoLayout> make(PangoContext* context, std::string_view text, Attributes attributes,
    const kit::TextLimits& limits);
/// Draws a layout with its images; the left end of the first line's top is at (0, 0).
void draw(cairo_t* cairo, PangoLayout* layout);

} // namespace TextLayout

} // namespace host::gtk
