// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// A finger that puts a popover away means nothing else. Under X the same touch comes to the window too, once
/// the popover has let go of the screen; it is kept from the window then. To be called once for each popover.
void keepDismissingTouchFromWindow(GtkWidget* popover);

} // namespace host::gtk
