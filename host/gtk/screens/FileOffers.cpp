// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/FileOffers.h"

#include "host/gtk/base/LocalFiles.h"
#include "host/gtk/base/SignalConnection.h"
#include "kit/controllers/Window.h"
#include "platform/Localization.h"

namespace host::gtk {

namespace {

using Model = std::weak_ptr<kit::Window>;

bool offer(const Model& model, const GValue* value)
{
    const auto shown = model.lock();
    if (!shown || !G_VALUE_HOLDS(value, GDK_TYPE_FILE_LIST))
        return false;
    const auto* list = static_cast<const GdkFileList*>(g_value_get_boxed(value));
    GSList* files = gdk_file_list_get_files(const_cast<GdkFileList*>(list));
    const auto found = LocalFiles::of(files);
    g_slist_free(files);
    if (!found.areAll)
        shown->showNotice(platform::localized("What isn’t on this device can’t be added."));
    return shown->filesOffered(found.files);
}

void clipboardWasRead(GObject* clipboard, GAsyncResult* result, gpointer data)
{
    const std::unique_ptr<Model> model(static_cast<Model*>(data));
    if (const auto* value = gdk_clipboard_read_value_finish(GDK_CLIPBOARD(clipboard), result, nullptr))
        offer(*model, value);
}

gboolean pastePressed(GtkWidget* window, GVariant*, gpointer data)
{
    const auto& model = *static_cast<Model*>(data);
    const auto shown = model.lock();
    const auto* focus = gtk_window_get_focus(GTK_WINDOW(window));
    auto* clipboard = gtk_widget_get_clipboard(window);
    const bool holdsFiles =
        gdk_content_formats_contain_gtype(gdk_clipboard_get_formats(clipboard), GDK_TYPE_FILE_LIST)
        || gdk_content_formats_contain_mime_type(gdk_clipboard_get_formats(clipboard), "text/uri-list");
    if (!shown || GTK_IS_TEXT(focus) || GTK_IS_TEXT_VIEW(focus) || !holdsFiles || !shown->takesFiles())
        return FALSE;
    gdk_clipboard_read_value_async(clipboard, GDK_TYPE_FILE_LIST, G_PRIORITY_DEFAULT, nullptr,
        clipboardWasRead, std::make_unique<Model>(model).release());
    return TRUE;
}

} // namespace

void connectFileOffers(GtkWidget* window, const std::shared_ptr<kit::Window>& model)
{
    auto* drops = gtk_drop_target_new(GDK_TYPE_FILE_LIST, GDK_ACTION_COPY);
    connectForLife<gboolean(GdkDrop*)>(
        drops, "accept", [shown = Model(model), drops](GdkDrop* drop) -> gboolean {
            const auto taking = shown.lock();
            return taking && !gdk_drop_get_drag(drop) && taking->takesFiles()
                && gdk_content_formats_match(
                    gdk_drop_get_formats(drop), gtk_drop_target_get_formats(GTK_DROP_TARGET(drops)));
        });
    connectForLife<gboolean(const GValue*, double, double)>(
        drops, "drop", [shown = Model(model)](const GValue* value, double, double) -> gboolean {
            return offer(shown, value);
        });
    gtk_widget_add_controller(window, GTK_EVENT_CONTROLLER(drops));

    auto* keys = gtk_shortcut_controller_new();
    gtk_shortcut_controller_add_shortcut(GTK_SHORTCUT_CONTROLLER(keys),
        gtk_shortcut_new(gtk_keyval_trigger_new(GDK_KEY_v, GDK_CONTROL_MASK),
            gtk_callback_action_new(pastePressed, std::make_unique<Model>(model).release(),
                [](gpointer data) { delete static_cast<Model*>(data); })));
    gtk_widget_add_controller(window, keys);
}

} // namespace host::gtk
