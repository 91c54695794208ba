// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/ZoomCanvas.h"

using host::gtk::ZoomCanvasClient;

namespace {

struct TrwZoomCanvas {
    GtkWidget parent;
    ZoomCanvasClient* client;
    GtkAdjustment* adjustments[2];
    gulong handlers[2];
    GtkScrollablePolicy policies[2];
};
struct TrwZoomCanvasClass {
    GtkWidgetClass parent;
};

enum Property { HorizontalAdjustment = 1, VerticalAdjustment, HorizontalPolicy, VerticalPolicy };

GType trw_zoom_canvas_get_type();
G_DEFINE_TYPE_WITH_CODE(
    TrwZoomCanvas, trw_zoom_canvas, GTK_TYPE_WIDGET, G_IMPLEMENT_INTERFACE(GTK_TYPE_SCROLLABLE, nullptr))

TrwZoomCanvas* canvasOf(gpointer object)
{
    return static_cast<TrwZoomCanvas*>(object);
}

void scrolled(TrwZoomCanvas* canvas)
{
    if (canvas->client)
        canvas->client->zoomCanvasScrolled();
    gtk_widget_queue_draw(GTK_WIDGET(canvas));
}

void setAdjustment(TrwZoomCanvas* canvas, int index, GtkAdjustment* adjustment)
{
    auto*& held = canvas->adjustments[index];
    if (held == adjustment && held)
        return;
    if (held) {
        g_signal_handler_disconnect(held, canvas->handlers[index]);
        g_clear_object(&held);
    }
    if (!adjustment)
        return;
    held = GTK_ADJUSTMENT(g_object_ref_sink(adjustment));
    canvas->handlers[index] =
        g_signal_connect_swapped(adjustment, "value-changed", G_CALLBACK(scrolled), canvas);
    gtk_widget_queue_allocate(GTK_WIDGET(canvas));
}

void setProperty(GObject* object, guint property, const GValue* value, GParamSpec*)
{
    auto* canvas = canvasOf(object);
    if (property == HorizontalAdjustment || property == VerticalAdjustment)
        setAdjustment(
            canvas, property == VerticalAdjustment, static_cast<GtkAdjustment*>(g_value_get_object(value)));
    else
        canvas->policies[property == VerticalPolicy] =
            static_cast<GtkScrollablePolicy>(g_value_get_enum(value));
}

void getProperty(GObject* object, guint property, GValue* value, GParamSpec*)
{
    const auto* canvas = canvasOf(object);
    if (property == HorizontalAdjustment || property == VerticalAdjustment)
        g_value_set_object(value, canvas->adjustments[property == VerticalAdjustment]);
    else
        g_value_set_enum(value, canvas->policies[property == VerticalPolicy]);
}

void allocate(GtkWidget* widget, int width, int height, int /*baseline*/)
{
    if (auto* client = canvasOf(widget)->client)
        client->zoomCanvasAllocate(width, height);
}

void snapshot(GtkWidget* widget, GtkSnapshot* into)
{
    auto* client = canvasOf(widget)->client;
    if (!client)
        return;
    graphene_rect_t bounds;
    graphene_rect_init(&bounds, 0, 0, static_cast<float>(gtk_widget_get_width(widget)),
        static_cast<float>(gtk_widget_get_height(widget)));
    gtk_snapshot_push_clip(into, &bounds);
    client->zoomCanvasSnapshot(into);
    gtk_snapshot_pop(into);
}

void dispose(GObject* object)
{
    setAdjustment(canvasOf(object), 0, nullptr);
    setAdjustment(canvasOf(object), 1, nullptr);
    G_OBJECT_CLASS(trw_zoom_canvas_parent_class)->dispose(object);
}

void trw_zoom_canvas_class_init(TrwZoomCanvasClass* type)
{
    auto* object = G_OBJECT_CLASS(type);
    object->set_property = setProperty;
    object->get_property = getProperty;
    object->dispose = dispose;
    g_object_class_override_property(object, HorizontalAdjustment, "hadjustment");
    g_object_class_override_property(object, VerticalAdjustment, "vadjustment");
    g_object_class_override_property(object, HorizontalPolicy, "hscroll-policy");
    g_object_class_override_property(object, VerticalPolicy, "vscroll-policy");
    auto* widget = GTK_WIDGET_CLASS(type);
    widget->size_allocate = allocate;
    widget->snapshot = snapshot;
    gtk_widget_class_set_css_name(widget, "zoomcanvas");
}

void trw_zoom_canvas_init(TrwZoomCanvas* canvas)
{
    gtk_widget_set_focusable(GTK_WIDGET(canvas), TRUE);
}

} // namespace

namespace host::gtk::ZoomCanvas {

GtkWidget* make(GtkAccessibleRole role)
{
    return GTK_WIDGET(g_object_new(trw_zoom_canvas_get_type(), "accessible-role", role, nullptr));
}

void setClient(GtkWidget* canvas, ZoomCanvasClient* client)
{
    canvasOf(canvas)->client = client;
}

GtkAdjustment* adjustment(GtkWidget* canvas, GtkOrientation orientation)
{
    return canvasOf(canvas)->adjustments[orientation == GTK_ORIENTATION_VERTICAL];
}

} // namespace host::gtk::ZoomCanvas
