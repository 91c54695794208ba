// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This is the floor of the start's benchmark: a libadwaita window with only a header bar and one label.

#include <adwaita.h>

namespace {

gboolean quit(gpointer application)
{
    g_application_quit(G_APPLICATION(application));
    return G_SOURCE_REMOVE;
}

void painted(GdkFrameClock* clock, gpointer application)
{
    g_signal_handlers_disconnect_by_data(clock, application);
    g_printerr("First list on screen\n");
    g_idle_add(quit, application);
}

void activate(GtkApplication* application, gpointer)
{
    auto* window = adw_application_window_new(application);
    auto* box = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_box_append(GTK_BOX(box), adw_header_bar_new());
    gtk_box_append(GTK_BOX(box), gtk_label_new("Bare window"));
    adw_application_window_set_content(ADW_APPLICATION_WINDOW(window), box);
    gtk_window_set_default_size(GTK_WINDOW(window), 900, 700);
    gtk_widget_realize(window);
    auto* clock = gtk_widget_get_frame_clock(window);
    g_signal_connect(clock, "after-paint", G_CALLBACK(painted), application);
    gtk_window_present(GTK_WINDOW(window));
}

} // namespace

int main(int argc, char** argv)
{
    auto* application = adw_application_new("app.tarrow.BareWindow", G_APPLICATION_NON_UNIQUE);
    g_signal_connect(application, "activate", G_CALLBACK(activate), nullptr);
    const int status = g_application_run(G_APPLICATION(application), argc, argv);
    g_object_unref(application);
    return status;
}
