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

/// Turns the kit's texts into Pango's, the same for measuring and for showing.
namespace TextLayout {

using Attributes = std::unique_ptr<PangoAttrList, decltype(&pango_attr_list_unref)>;

/// Answers attributes for the font and, when there is one, the colour of a whole text.
Attributes attributes(const Theme& theme, const kit::Font& font, const platform::Color* color);
/// Answers the attributes of a styled text. Pieces without a font get `font`. The byte offsets are those of
/// `text(...)`.
Attributes attributes(const Theme& theme, const kit::AttributedText& text, const kit::Font& font);
/// Answers the characters, with one object replacement character for each image.
std::string text(const kit::AttributedText& text);
bool hasAttachments(const kit::AttributedText& text);

ObjectRef<PangoLayout> make(
    PangoContext* context, std::string_view characters, Attributes attributes, const kit::TextLimits& limits);
/// Draws a layout with its images. The top left corner of the first line is at (0, 0).
void draw(cairo_t* cairo, PangoLayout* layout);

} // namespace TextLayout

} // namespace host::gtk
