// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ButtonPeer.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/views/LabelPeer.h"
#include "kit/views/Button.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace {

constexpr double fingerSize = 44; ///< points

struct TrwButton {
    GtkButton parent;
};

struct TrwButtonClass {
    GtkButtonClass parent;
};

G_DEFINE_TYPE(TrwButton, trw_button, GTK_TYPE_BUTTON)

gboolean contains(GtkWidget* widget, double x, double y)
{
    const auto reaches = [](double at, double length) {
        const double margin = std::max(0.0, (fingerSize - length) / 2);
        return at >= -margin && at < length + margin;
    };
    return reaches(x, gtk_widget_get_width(widget)) && reaches(y, gtk_widget_get_height(widget));
}

void trw_button_class_init(TrwButtonClass* type)
{
    GTK_WIDGET_CLASS(type)->contains = contains;
    gtk_widget_class_set_accessible_role(GTK_WIDGET_CLASS(type), GTK_ACCESSIBLE_ROLE_BUTTON);
}

void trw_button_init(TrwButton*) { }

} // namespace

namespace host::gtk {

namespace {

constexpr int iconSize = 16;

const char* styleClass(kit::ButtonStyle style)
{
    switch (style) {
    case kit::ButtonStyle::System:
        return "system";
    case kit::ButtonStyle::Suggested:
        return "suggested-action";
    case kit::ButtonStyle::Destructive:
        return "destructive";
    }
    return "system";
}

} // namespace

GtkWidget* makeTouchButton()
{
    return GTK_WIDGET(g_object_new(trw_button_get_type(), nullptr));
}

ButtonPeer::ButtonPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::Button>& button)
    : ViewPeer(std::move(context), button)
    , _button(button)
    , _icon(gtk_image_new())
    , _title(gtk_label_new(nullptr))
{
    auto* content = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 6);
    gtk_widget_set_halign(content, GTK_ALIGN_CENTER);
    gtk_box_append(GTK_BOX(content), _icon);
    gtk_box_append(GTK_BOX(content), _title);
    auto* made = makeTouchButton();
    gtk_button_set_child(GTK_BUTTON(made), content);
    gtk_widget_add_css_class(made, "kit-button");
    setNative(made);
    connect(connectSignal<void()>(made, "clicked", platform::weakly(_button, &kit::Button::press)));
}

void ButtonPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto button = _button.lock();
    if (button && changes.contains(kit::ViewChange::Content))
        mirrorContent(*button);
}

void ButtonPeer::mirrorContent(const kit::Button& button)
{
    showLabel(GTK_LABEL(_title), *button.titleLabel(), context().theme());
    gtk_widget_set_visible(_title, !button.title().empty());
    gtk_widget_set_visible(_icon, button.image().has_value());
    if (button.image())
        ImagePaint::show(GTK_IMAGE(_icon), *button.image(), iconSize);
    for (const char* other : {"system", "suggested-action", "destructive"})
        gtk_widget_remove_css_class(native(), other);
    gtk_widget_add_css_class(native(), styleClass(button.buttonStyle()));
    if (button.accessibility().label.empty())
        gtk_accessible_update_property(
            GTK_ACCESSIBLE(native()), GTK_ACCESSIBLE_PROPERTY_LABEL, button.title().c_str(), -1);
}

} // namespace host::gtk
