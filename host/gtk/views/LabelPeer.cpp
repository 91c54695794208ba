// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/LabelPeer.h"

#include "host/gtk/base/TextLayout.h"
#include "kit/views/Label.h"

namespace host::gtk {

namespace {

/// Answers GTK's alignment. Its left end is where the text begins; the kit's Left is a side of the window.
float horizontalAlign(kit::TextAlignment alignment, bool rightToLeft)
{
    switch (alignment) {
    case kit::TextAlignment::Natural:
        return 0;
    case kit::TextAlignment::Left:
        return rightToLeft ? 1 : 0;
    case kit::TextAlignment::Center:
        return 0.5F;
    case kit::TextAlignment::Right:
        return rightToLeft ? 0 : 1;
    }
    return 0;
}

/// Answers the share of the free room that stands to the left of a drawn text.
double shareOfRoomBefore(kit::TextAlignment alignment, bool rightToLeft)
{
    const double fromStart = horizontalAlign(alignment, rightToLeft);
    return rightToLeft ? 1 - fromStart : fromStart;
}

PangoAlignment pangoAlignment(kit::TextAlignment alignment)
{
    switch (alignment) {
    case kit::TextAlignment::Center:
        return PANGO_ALIGN_CENTER;
    case kit::TextAlignment::Right:
        return PANGO_ALIGN_RIGHT;
    default:
        return PANGO_ALIGN_LEFT;
    }
}

GtkJustification justification(kit::TextAlignment alignment)
{
    switch (alignment) {
    case kit::TextAlignment::Center:
        return GTK_JUSTIFY_CENTER;
    case kit::TextAlignment::Right:
        return GTK_JUSTIFY_RIGHT;
    default:
        return GTK_JUSTIFY_LEFT;
    }
}

PangoEllipsizeMode ellipsis(const kit::Label& label)
{
    switch (label.lineBreak()) {
    case kit::LineBreak::TruncateMiddle:
        return PANGO_ELLIPSIZE_MIDDLE;
    case kit::LineBreak::TruncateTail:
        return label.maxLines() == 0 ? PANGO_ELLIPSIZE_NONE : PANGO_ELLIPSIZE_END;
    case kit::LineBreak::WordWrap:
        return label.maxLines() > 1 ? PANGO_ELLIPSIZE_END : PANGO_ELLIPSIZE_NONE;
    }
    return PANGO_ELLIPSIZE_END;
}

TextLayout::Attributes attributesOf(const kit::Label& label, const Theme& theme)
{
    if (const auto& styled = label.attributedText())
        return TextLayout::attributes(theme, *styled, label.font());
    const auto& color = label.textColor();
    return TextLayout::attributes(theme, label.font(), color ? &*color : nullptr);
}

bool isDrawn(const kit::Label& label)
{
    return label.attributedText() && TextLayout::hasAttachments(*label.attributedText());
}

} // namespace

void showLabel(GtkLabel* widget, const kit::Label& label, const Theme& theme)
{
    const bool wraps = label.maxLines() != 1;
    const bool rightToLeft = gtk_widget_get_direction(GTK_WIDGET(widget)) == GTK_TEXT_DIR_RTL;
    const std::string text =
        label.attributedText() ? TextLayout::text(*label.attributedText()) : label.text();
    gtk_label_set_label(widget, text.c_str());
    gtk_label_set_attributes(widget, attributesOf(label, theme).get());
    gtk_label_set_wrap(widget, wraps);
    gtk_label_set_wrap_mode(widget, PANGO_WRAP_WORD_CHAR);
    gtk_label_set_lines(widget, wraps && label.maxLines() > 0 ? label.maxLines() : -1);
    gtk_label_set_ellipsize(widget, ellipsis(label));
    gtk_label_set_xalign(widget, horizontalAlign(label.alignment(), rightToLeft));
    gtk_label_set_justify(widget, justification(label.alignment()));
}

LabelPeer::LabelPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::Label>& label)
    : ViewPeer(std::move(context), label)
    , _label(label)
{
    setNative(gtk_label_new(nullptr));
}

void LabelPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto label = _label.lock();
    if (!label || !changes.contains(kit::ViewChange::Content))
        return;
    const bool drawn = isDrawn(*label);
    showLabel(GTK_LABEL(native()), *label, context().theme());
    gtk_widget_set_opacity(native(), drawn ? 0 : 1);
    // Assistive technology reads the invisible label, and shall not hear a placeholder for each image.
    if (drawn) {
        gtk_label_set_attributes(GTK_LABEL(native()), nullptr);
        gtk_label_set_label(GTK_LABEL(native()), label->text().c_str());
    }
    gtk_widget_queue_draw(widget());
}

void LabelPeer::canvasSnapshot(GtkSnapshot* snapshot)
{
    ViewPeer::canvasSnapshot(snapshot);
    const auto label = _label.lock();
    if (!label || !isDrawn(*label))
        return;
    const double width = gtk_widget_get_width(widget()), height = gtk_widget_get_height(widget());
    const auto pango = ObjectRef<PangoContext>::adopt(gtk_widget_create_pango_context(widget()));
    const auto layout = TextLayout::make(pango.get(), TextLayout::text(*label->attributedText()),
        attributesOf(*label, context().theme()), {width, label->maxLines()});
    const bool rightToLeft = gtk_widget_get_direction(widget()) == GTK_TEXT_DIR_RTL;
    pango_layout_set_alignment(layout.get(), pangoAlignment(label->alignment()));
    PangoRectangle logical;
    pango_layout_get_pixel_extents(layout.get(), nullptr, &logical);
    graphene_rect_t bounds;
    graphene_rect_init(&bounds, 0, 0, static_cast<float>(width), static_cast<float>(height));
    auto* cairo = gtk_snapshot_append_cairo(snapshot, &bounds);
    GdkRGBA color;
    gtk_style_context_get_color(gtk_widget_get_style_context(widget()), &color);
    gdk_cairo_set_source_rgba(cairo, &color);
    const double share = shareOfRoomBefore(label->alignment(), rightToLeft);
    cairo_move_to(cairo, (width - logical.width) * share - logical.x, (height - logical.height) / 2);
    TextLayout::draw(cairo, layout.get());
    cairo_destroy(cairo);
}

} // namespace host::gtk
