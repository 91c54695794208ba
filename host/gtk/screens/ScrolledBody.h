// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// Answers a widget around a body that is as high as the body's lines need in the given width, and scrolls
/// the body where there is less room. A scrolled window alone would ask for the height of unbroken lines.
GtkWidget* makeScrolledBody(GtkWidget* body);

} // namespace host::gtk
