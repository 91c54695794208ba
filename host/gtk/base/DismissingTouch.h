// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// A touch that closes a popover must do nothing else. Under X the same touch also reaches the window once
/// the popover has released its grab; this keeps it from the window. Call it once for each popover.
void keepDismissingTouchFromWindow(GtkWidget* popover);

} // namespace host::gtk
