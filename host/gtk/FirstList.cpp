#include "host/gtk/FirstList.h"

#include "platform/Log.h"

namespace host::gtk {

namespace {

void painted(GdkFrameClock* clock, gpointer data)
{
    static constexpr platform::Operation op{"noteFirstList"};
    g_signal_handlers_disconnect_by_data(clock, data);
    op.info("First list on screen");
}

} // namespace

void noteFirstList(GtkWidget* list)
{
    static bool noted = false;
    auto* clock = gtk_widget_get_frame_clock(list);
    if (noted || !clock)
        return;
    noted = true;
    g_signal_connect(clock, "after-paint", G_CALLBACK(painted), &noted);
    gtk_widget_queue_draw(list);
}

} // namespace host::gtk
