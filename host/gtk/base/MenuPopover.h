// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Menu.h"

#include <gtk/gtk.h>

namespace host::gtk {

/// Shows a context menu at a point of a widget. The menu closes with the widget when that is no longer shown,
/// and destroys itself when it is closed; an entry's handler runs after that.
void showMenu(GtkWidget* parent, double x, double y, const kit::Menu& menu);

} // namespace host::gtk
