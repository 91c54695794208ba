#pragma once

#include "platform/ui/ListRow.h"

#include <gtk/gtk.h>

namespace host::gtk {

/// The widget of one row of a list. To assistive technology it is a button with the action "row.activate".
namespace ListRowWidget {

GtkWidget* make(GtkListItem* item);
bool isRow(GtkWidget* widget);
/// Shows a row; cheap when it is what the widget shows already.
void show(GtkWidget* row, const platform::ui::ListRow& content, double height);
const platform::ui::ListRow& shown(GtkWidget* row);
guint position(GtkWidget* row);
/// The text of the title, as the label has it.
const char* titleText(GtkWidget* row);

} // namespace ListRowWidget

} // namespace host::gtk
