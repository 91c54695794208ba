// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/CanvasWidget.h"

#include <algorithm>
#include <cmath>

namespace {

struct TrwCanvas {
    GtkWidget parent;
    host::gtk::CanvasClient* client;
};

struct TrwCanvasClass {
    GtkWidgetClass parent;
};

G_DEFINE_TYPE(TrwCanvas, trw_canvas, GTK_TYPE_WIDGET)

TrwCanvas* canvasOf(GtkWidget* widget)
{
    return reinterpret_cast<TrwCanvas*>(widget);
}

GtkSizeRequestMode requestMode(GtkWidget*)
{
    return GTK_SIZE_REQUEST_HEIGHT_FOR_WIDTH;
}

void measure(GtkWidget* widget, GtkOrientation orientation, int forSize, int* minimum, int* natural,
    int* minimumBaseline, int* naturalBaseline)
{
    *minimum = *natural = 0;
    *minimumBaseline = *naturalBaseline = -1;
    const auto* canvas = canvasOf(widget);
    if (!canvas->client)
        return;
    const bool isHeight = orientation == GTK_ORIENTATION_VERTICAL;
    const auto size = canvas->client->canvasNaturalSize(isHeight ? forSize : -1);
    *natural = static_cast<int>(std::ceil(std::max(0.0, isHeight ? size.height : size.width)));
    if (isHeight)
        *minimum = *natural;
}

void allocate(GtkWidget* widget, int width, int height, int /*baseline*/)
{
    if (auto* client = canvasOf(widget)->client)
        client->canvasAllocate(width, height);
    // A popover has a surface of its own and follows its anchor only when it is presented again.
    for (auto* child = gtk_widget_get_first_child(widget); child;
         child = gtk_widget_get_next_sibling(child)) {
        if (GTK_IS_POPOVER(child))
            gtk_popover_present(GTK_POPOVER(child));
    }
}

void snapshot(GtkWidget* widget, GtkSnapshot* target)
{
    if (auto* client = canvasOf(widget)->client)
        client->canvasSnapshot(target);
}

gboolean contains(GtkWidget* widget, double x, double y)
{
    if (auto* client = canvasOf(widget)->client)
        return client->canvasContains(x, y);
    return FALSE;
}

gboolean focus(GtkWidget* widget, GtkDirectionType direction)
{
    if (!GTK_WIDGET_CLASS(trw_canvas_parent_class)->focus(widget, direction))
        return FALSE;
    auto* client = canvasOf(widget)->client;
    return gtk_widget_get_focus_child(widget) || gtk_widget_is_focus(widget)
        || (client && client->canvasTakesFocus());
}

void dispose(GObject* object)
{
    auto* widget = GTK_WIDGET(object);
    canvasOf(widget)->client = nullptr;
    while (GtkWidget* child = gtk_widget_get_first_child(widget))
        gtk_widget_unparent(child);
    G_OBJECT_CLASS(trw_canvas_parent_class)->dispose(object);
}

void trw_canvas_class_init(TrwCanvasClass* type)
{
    G_OBJECT_CLASS(type)->dispose = dispose;
    auto* widget = GTK_WIDGET_CLASS(type);
    widget->get_request_mode = requestMode;
    widget->measure = measure;
    widget->size_allocate = allocate;
    widget->snapshot = snapshot;
    widget->contains = contains;
    widget->focus = focus;
    gtk_widget_class_set_css_name(widget, "canvas");
    gtk_widget_class_set_accessible_role(widget, GTK_ACCESSIBLE_ROLE_GROUP);
}

void trw_canvas_init(TrwCanvas*) { }

} // namespace

namespace host::gtk::CanvasWidget {

GType type()
{
    return trw_canvas_get_type();
}

GtkWidget* make(GtkAccessibleRole role)
{
    return GTK_WIDGET(g_object_new(trw_canvas_get_type(), "accessible-role", role, nullptr));
}

void setClient(GtkWidget* canvas, CanvasClient* client)
{
    canvasOf(canvas)->client = client;
}

void insertAfter(GtkWidget* canvas, GtkWidget* child, GtkWidget* previous)
{
    gtk_widget_insert_after(child, canvas, previous);
}

void allocateChild(GtkWidget* child, const platform::Rect& frame)
{
    if (!gtk_widget_should_layout(child))
        return;
    const double scale = gtk_widget_get_scale_factor(child);
    const double x = std::round(frame.x * scale) / scale, y = std::round(frame.y * scale) / scale;
    int minimumWidth = 0, minimumHeight = 0;
    gtk_widget_measure(child, GTK_ORIENTATION_HORIZONTAL, -1, &minimumWidth, nullptr, nullptr, nullptr);
    // A width such as 83.999 comes from the solver's arithmetic, and must not cost a text its last letter.
    const int width = std::max(static_cast<int>(std::ceil(std::max(0.0, frame.width) - 0.01)), minimumWidth);
    gtk_widget_measure(child, GTK_ORIENTATION_VERTICAL, width, &minimumHeight, nullptr, nullptr, nullptr);
    const int height =
        std::max(static_cast<int>(std::ceil(std::max(0.0, frame.height) - 0.01)), minimumHeight);
    graphene_point_t origin;
    graphene_point_init(&origin, static_cast<float>(x), static_cast<float>(y));
    gtk_widget_allocate(child, width, height, -1, gsk_transform_translate(nullptr, &origin));
}

void snapshotChildren(GtkWidget* canvas, GtkSnapshot* snapshot)
{
    for (auto* child = gtk_widget_get_first_child(canvas); child; child = gtk_widget_get_next_sibling(child))
        gtk_widget_snapshot_child(canvas, child, snapshot);
}

} // namespace host::gtk::CanvasWidget
