// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"

#include <functional>

#include <gtk/gtk.h>

namespace host::gtk {

/// The widget of one row of a list. To assistive technology it is a button with the actions "row.activate",
/// "row.menu" and "row.peek".
namespace ListRowWidget {

/// The actions that a row requests at its present place.
enum class Request { Menu, Peek };
/// The place is in the row's own coordinates.
using Handler = std::function<void(GtkWidget* row, Request request, double x, double y)>;

GtkWidget* make(GtkListItem* item, Handler handler);
bool isRow(GtkWidget* widget);
/// Makes the widget take the room of a row that is shown later.
void reserve(GtkWidget* row, double height);
/// Shows a row. It is cheap when the widget shows the row already.
void show(GtkWidget* widget, const kit::ListRow& content, double height);
/// Makes the widget take the room of a row and names it for assistive technology, without the parts that a
/// person would see.
void announce(GtkWidget* widget, const kit::ListRow& content, double height);
/// Answers whether the widget has these parts.
bool isShown(GtkWidget* row);
const kit::ListRow& shown(GtkWidget* row);
guint position(GtkWidget* row);
/// Answers whether a point of the row, in its own coordinates, lies on the check mark or before it.
bool isOnMark(GtkWidget* row, double x);
/// Answers the text of the title's label.
const char* titleText(GtkWidget* row);

} // namespace ListRowWidget

} // namespace host::gtk
