// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// A widget around a body that is as high as the body's lines need in the width it gets, and scrolls the body
/// where there is less room. The scrolled window alone asks for the height of lines that are not broken.
GtkWidget* makeScrolledBody(GtkWidget* body);

} // namespace host::gtk
