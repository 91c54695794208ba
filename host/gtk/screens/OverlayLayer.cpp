// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/OverlayLayer.h"

#include <utility>

namespace host::gtk {

namespace {

constexpr int alertWidth = 340, sheetWidth = 640; ///< points, at most
constexpr int edgeDistance = 12;
constexpr int leastBackdrop = 44; ///< of the backdrop above a sheet, so that a finger can end it there
constexpr unsigned fadeMilliseconds = 150;

GtkWidget* makeClamp(GtkWidget* child, int width)
{
    auto* clamp = adw_clamp_new();
    adw_clamp_set_maximum_size(ADW_CLAMP(clamp), width);
    adw_clamp_set_tightening_threshold(ADW_CLAMP(clamp), width);
    adw_clamp_set_child(ADW_CLAMP(clamp), child);
    gtk_widget_set_hexpand(clamp, TRUE);
    gtk_widget_set_vexpand(clamp, TRUE);
    return clamp;
}

void setMargins(GtkWidget* widget, int margin)
{
    gtk_widget_set_margin_start(widget, margin);
    gtk_widget_set_margin_end(widget, margin);
    gtk_widget_set_margin_top(widget, margin);
    gtk_widget_set_margin_bottom(widget, margin);
}

} // namespace

OverlayLayer::OverlayLayer(GtkOverlay* overlay, std::unique_ptr<LayerContent> content, LayerPlace layerPlace,
    std::function<void()> onOutside)
    : _overlay(ObjectRef<GtkOverlay>::retain(overlay))
    , _content(std::move(content))
    , _backdrop(ObjectRef<GtkWidget>::retain(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))
    , _card(_content->widget())
{
    place(layerPlace);
    connectOutside(std::move(onOutside));
    // A revealer is not used here, because its content takes no key before the first frame.
    gtk_overlay_add_overlay(overlay, _backdrop.get());
}

OverlayLayer::~OverlayLayer()
{
    _onFaded.disconnect();
    _onPressed.disconnect();
    if (gtk_widget_get_parent(_backdrop.get()) == GTK_WIDGET(_overlay.get()))
        gtk_overlay_remove_overlay(_overlay.get(), _backdrop.get());
    // The content is destroyed first, while its widgets are still in the layer.
    _content.reset();
}

void OverlayLayer::place(LayerPlace layerPlace)
{
    gtk_widget_add_css_class(_card, "layer-card");
    gtk_widget_set_overflow(_card, GTK_OVERFLOW_HIDDEN);
    gtk_widget_add_css_class(_backdrop.get(), "layer-backdrop");
    GtkWidget* placed = _card;
    switch (layerPlace) {
    case LayerPlace::Center:
        gtk_widget_set_valign(_card, GTK_ALIGN_CENTER);
        setMargins(_card, edgeDistance);
        placed = makeClamp(_card, alertWidth);
        break;
    case LayerPlace::Bottom:
        gtk_widget_set_valign(_card, GTK_ALIGN_END);
        setMargins(_card, edgeDistance);
        gtk_widget_set_margin_top(_card, leastBackdrop);
        placed = makeClamp(_card, sheetWidth);
        break;
    case LayerPlace::Sheet:
        gtk_widget_set_vexpand(_card, TRUE);
        setMargins(_card, edgeDistance * 2);
        placed = makeClamp(_card, sheetWidth);
        break;
    case LayerPlace::Cover:
        gtk_widget_set_vexpand(_card, TRUE);
        gtk_widget_add_css_class(_card, "cover");
        break;
    }
    gtk_box_append(GTK_BOX(_backdrop.get()), placed);
}

void OverlayLayer::connectOutside(std::function<void()> onOutside)
{
    auto* click = gtk_gesture_click_new();
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(click), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_backdrop.get(), GTK_EVENT_CONTROLLER(click));
    _onPressed = connectSignal<void(int, double, double)>(
        click, "released", [this, call = std::move(onOutside)](int, double x, double y) {
            auto* hit = gtk_widget_pick(_backdrop.get(), x, y, GTK_PICK_DEFAULT);
            const bool inside = hit && (hit == _card || gtk_widget_is_ancestor(hit, _card));
            if (const auto outside = call; !inside && outside)
                outside();
        });
}

void OverlayLayer::show(bool animated, Done done)
{
    gtk_widget_set_opacity(_backdrop.get(), 0);
    fadeTo(1, animated, std::move(done));
}

void OverlayLayer::hide(bool animated, Done done)
{
    gtk_widget_set_can_target(_backdrop.get(), FALSE);
    fadeTo(0, animated, std::move(done));
}

void OverlayLayer::fadeTo(double opacity, bool animated, Done done)
{
    _onFaded.disconnect();
    if (const auto earlier = std::exchange(_done, {}))
        earlier();
    auto* backdrop = _backdrop.get();
    if (!animated) {
        gtk_widget_set_opacity(backdrop, opacity);
        done();
        return;
    }
    _done = std::move(done);
    auto* target = adw_callback_animation_target_new(
        [](double value, gpointer widget) { gtk_widget_set_opacity(GTK_WIDGET(widget), value); }, backdrop,
        nullptr);
    _fade = ObjectRef<AdwAnimation>::adopt(adw_timed_animation_new(
        backdrop, gtk_widget_get_opacity(backdrop), opacity, fadeMilliseconds, target));
    _onFaded = connectSignal<void()>(_fade.get(), "done", [this] {
        if (const auto ended = std::exchange(_done, {}))
            ended();
    });
    adw_animation_play(_fade.get());
}

void OverlayLayer::focus()
{
    _content->focus();
}

void OverlayLayer::setCovered(bool covered)
{
    gtk_widget_set_can_focus(_backdrop.get(), !covered);
    gtk_widget_set_can_target(_backdrop.get(), !covered);
}

} // namespace host::gtk
