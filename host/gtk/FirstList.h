#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// Logs once for the process, when the frame that shows the first list with rows has been painted: the end of
/// the start, which the start's benchmark waits for. Main thread; cheap to call again.
void noteFirstList(GtkWidget* list);

} // namespace host::gtk
