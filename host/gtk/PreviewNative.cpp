#include "host/gtk/PreviewNative.h"

#include "host/gtk/MediaNative.h"
#include "host/gtk/PagesNative.h"
#include "host/gtk/PictureNative.h"
#include "host/gtk/TextNative.h"

#include <adwaita.h>

#include <functional>

namespace host::gtk {

namespace components = platform::components;
namespace ui = platform::ui;
using components::PreviewView;

namespace {

constexpr const char* nativeKey = "trw-preview-native";

/// The native view lives in a holder of its own: it keeps its widgets, the holder keeps it.
ObjectRef<GtkWidget> hold(std::shared_ptr<PreviewNative> native)
{
    auto holder = ObjectRef<GtkWidget>::retain(adw_bin_new());
    adw_bin_set_child(ADW_BIN(holder.get()), native->widget());
    g_object_set_data_full(G_OBJECT(holder.get()), nativeKey,
        std::make_unique<std::shared_ptr<PreviewNative>>(std::move(native)).release(),
        [](gpointer held) { delete static_cast<std::shared_ptr<PreviewNative>*>(held); });
    return holder;
}

template <typename View, typename Native>
void addMaker(PeerContext& context)
{
    context.setHostedViewMaker(
        View::kindName, [](ui::HostedView& hosted, GtkWidget* current) -> ObjectRef<GtkWidget> {
            if (current)
                return ObjectRef<GtkWidget>::retain(current);
            // The kind says what the view is.
            const auto view = std::static_pointer_cast<View>(hosted.shared_from_this());
            const auto native = std::make_shared<Native>(view);
            native->start();
            view->setPreviewObserver(native);
            return hold(native);
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

void PreviewNative::addShortcuts(GtkWidget* widget, const std::weak_ptr<PreviewView>& view)
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
    add("<Control>g|F3", [](PreviewView& shown) { shown.showMatch(components::MatchStep::Next); });
    add("<Control><Shift>g|<Shift>F3",
        [](PreviewView& shown) { shown.showMatch(components::MatchStep::Previous); });
    gtk_widget_add_controller(widget, controller);
}

void addPreviewMakers(PeerContext& context)
{
    addMaker<components::PreviewPictureView, PictureNative>(context);
    addMaker<components::PreviewPagesView, PagesNative>(context);
    addMaker<components::PreviewTextView, TextNative>(context);
    addMaker<components::PreviewMediaView, MediaNative>(context);
}

} // namespace host::gtk
