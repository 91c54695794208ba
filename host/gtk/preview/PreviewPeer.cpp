// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PreviewPeer.h"

#include "host/gtk/preview/PagesPeer.h"
#include "host/gtk/preview/PicturePeer.h"
#include "host/gtk/preview/PreviewModule.h"
#include "platform/Weakly.h"
#include "screens/preview/PreviewMediaView.h"
#include "screens/preview/PreviewTextView.h"

#include <adwaita.h>

#include <functional>

namespace host::gtk {
using screens::PreviewView;

namespace {

constexpr const char* peerKey = "trw-preview-peer";

using Peer = std::shared_ptr<PreviewPeer>;

void show(GtkWidget* holder, PreviewView& view, const Peer& peer)
{
    peer->start();
    view.setPreviewObserver(peer);
    adw_bin_set_child(ADW_BIN(holder), peer->widget());
    // The peer owns its widgets, and the holder keeps the peer alive.
    g_object_set_data_full(G_OBJECT(holder), peerKey, std::make_unique<Peer>(peer).release(),
        [](gpointer held) { delete static_cast<Peer*>(held); });
}

/// Registers a maker. `fill` puts the peer of a new view into its holder, at once or later.
template <typename View, typename Fill>
void addMaker(PeerContext& context, const Fill& fill)
{
    context.setHostedViewMaker(
        View::kindName, [fill](kit::HostedView& hosted, GtkWidget* current) -> ObjectRef<GtkWidget> {
            if (current)
                return ObjectRef<GtkWidget>::retain(current);
            auto holder = ObjectRef<GtkWidget>::retain(adw_bin_new());
            // The cast is safe, because the kind of a hosted view decides its class.
            fill(holder, std::static_pointer_cast<View>(hosted.shared_from_this()));
            return holder;
        });
}

template <typename View, typename Made>
void addOwnMaker(PeerContext& context)
{
    addMaker<View>(context, [](const ObjectRef<GtkWidget>& holder, const std::shared_ptr<View>& view) {
        show(holder.get(), *view, std::make_shared<Made>(view));
    });
}

template <typename View>
void addModuleMaker(PeerContext& context, const std::shared_ptr<PreviewModule>& previews,
    Peer (PreviewLibraries::*make)(const std::shared_ptr<View>&) const)
{
    addMaker<View>(
        context, [previews, make](const ObjectRef<GtkWidget>& holder, const std::shared_ptr<View>& view) {
            previews->whenLoaded(platform::weakly(view, [holder, make](View& shown, const auto& libraries) {
                if (libraries)
                    show(holder.get(), shown,
                        ((*libraries).*make)(std::static_pointer_cast<View>(shown.shared_from_this())));
                else
                    shown.peerFailed(PreviewModule::missingWords());
            }));
        });
}

using Command = std::function<void(PreviewView&)>;

void addShortcut(GtkEventController* controller, const std::weak_ptr<PreviewView>& view, const char* trigger,
    const Command& command)
{
    struct Target {
        std::weak_ptr<PreviewView> view;
        Command command;
    };
    const auto call = [](GtkWidget* shown, GVariant*, gpointer data) -> gboolean {
        const auto* target = static_cast<Target*>(data);
        const auto seen = gtk_widget_get_mapped(shown) ? target->view.lock() : nullptr;
        if (seen)
            target->command(*seen);
        return seen ? TRUE : FALSE;
    };
    auto* action = gtk_callback_action_new(call, std::make_unique<Target>(Target{view, command}).release(),
        [](gpointer data) { delete static_cast<Target*>(data); });
    gtk_shortcut_controller_add_shortcut(GTK_SHORTCUT_CONTROLLER(controller),
        gtk_shortcut_new(gtk_shortcut_trigger_parse_string(trigger), action));
}

} // namespace

void PreviewPeer::addShortcuts(GtkWidget* widget, const std::weak_ptr<PreviewView>& view)
{
    auto* controller = gtk_shortcut_controller_new();
    gtk_shortcut_controller_set_scope(GTK_SHORTCUT_CONTROLLER(controller), GTK_SHORTCUT_SCOPE_GLOBAL);
    const auto add = [&](const char* trigger, const Command& command) {
        addShortcut(controller, view, trigger, command);
    };
    add("<Control>f", [](PreviewView& shown) { shown.userWantsToFind(); });
    add("<Control>plus|<Control>equal|<Control>KP_Add",
        [](PreviewView& shown) { shown.setZoom(shown.zoom() * PreviewView::zoomStep); });
    add("<Control>minus|<Control>KP_Subtract",
        [](PreviewView& shown) { shown.setZoom(shown.zoom() / PreviewView::zoomStep); });
    add("<Control>0|<Control>KP_0", [](PreviewView& shown) { shown.setZoom(PreviewView::minZoom); });
    add("<Control>g|F3", [](PreviewView& shown) { shown.showMatch(screens::MatchStep::Next); });
    add("<Control><Shift>g|<Shift>F3",
        [](PreviewView& shown) { shown.showMatch(screens::MatchStep::Previous); });
    gtk_widget_add_controller(widget, controller);
}

void addPreviewMakers(PeerContext& context, const std::shared_ptr<PreviewModule>& previews)
{
    addOwnMaker<screens::PreviewPictureView, PicturePeer>(context);
    addOwnMaker<screens::PreviewPagesView, PagesPeer>(context);
    addModuleMaker(context, previews, &PreviewLibraries::makeTextPeer);
    addModuleMaker(context, previews, &PreviewLibraries::makeMediaPeer);
}

} // namespace host::gtk
