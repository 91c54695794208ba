#include "host/gtk/OverlayLayer.h"

#include <adwaita.h>

#include <utility>

namespace host::gtk {

namespace {

constexpr int alertWidth = 340, sheetWidth = 640; ///< points, at most
constexpr int edgeDistance = 12;
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
    , _revealer(ObjectRef<GtkWidget>::retain(gtk_revealer_new()))
    , _backdrop(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0))
    , _card(_content->widget())
{
    place(layerPlace);
    connectOutside(std::move(onOutside));
    gtk_revealer_set_child(GTK_REVEALER(_revealer.get()), _backdrop);
    gtk_revealer_set_transition_type(GTK_REVEALER(_revealer.get()), GTK_REVEALER_TRANSITION_TYPE_CROSSFADE);
    gtk_overlay_add_overlay(overlay, _revealer.get());
}

OverlayLayer::~OverlayLayer()
{
    _onRevealed.disconnect();
    _onPressed.disconnect();
    if (gtk_widget_get_parent(_revealer.get()) == GTK_WIDGET(_overlay.get()))
        gtk_overlay_remove_overlay(_overlay.get(), _revealer.get());
    // The content takes its own widgets apart while they still stand in the layer.
    _content.reset();
}

void OverlayLayer::place(LayerPlace layerPlace)
{
    gtk_widget_add_css_class(_card, "layer-card");
    gtk_widget_set_overflow(_card, GTK_OVERFLOW_HIDDEN);
    gtk_widget_add_css_class(_backdrop, "layer-backdrop");
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
    gtk_box_append(GTK_BOX(_backdrop), placed);
}

void OverlayLayer::connectOutside(std::function<void()> onOutside)
{
    auto* click = gtk_gesture_click_new();
    gtk_event_controller_set_propagation_phase(GTK_EVENT_CONTROLLER(click), GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_backdrop, GTK_EVENT_CONTROLLER(click));
    _onPressed = connectSignal<void(int, double, double)>(
        click, "released", [this, call = std::move(onOutside)](int, double x, double y) {
            auto* hit = gtk_widget_pick(_backdrop, x, y, GTK_PICK_DEFAULT);
            const bool inside = hit && (hit == _card || gtk_widget_is_ancestor(hit, _card));
            if (const auto outside = call; !inside && outside)
                outside();
        });
}

void OverlayLayer::show(bool animated, Done done)
{
    reveal(true, animated, std::move(done));
}

void OverlayLayer::hide(bool animated, Done done)
{
    gtk_widget_set_can_target(_revealer.get(), FALSE);
    reveal(false, animated, std::move(done));
}

void OverlayLayer::reveal(bool revealed, bool animated, Done done)
{
    auto* revealer = GTK_REVEALER(_revealer.get());
    _onRevealed.disconnect();
    if (const auto earlier = std::exchange(_done, {}))
        earlier();
    gtk_revealer_set_transition_duration(revealer, animated ? fadeMilliseconds : 0);
    gtk_revealer_set_reveal_child(revealer, revealed);
    if ((gtk_revealer_get_child_revealed(revealer) != FALSE) == revealed || !animated) {
        done();
        return;
    }
    _done = std::move(done);
    _onRevealed = connectNotify(revealer, "notify::child-revealed", [this] {
        if (const auto ended = std::exchange(_done, {}))
            ended();
    });
}

void OverlayLayer::focus()
{
    _content->focus();
}

void OverlayLayer::setCovered(bool covered)
{
    gtk_widget_set_can_focus(_revealer.get(), !covered);
    gtk_widget_set_can_target(_revealer.get(), !covered);
}

} // namespace host::gtk
