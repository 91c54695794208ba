// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

#include <string>

namespace host::gtk {

/// Answers a widget for the text of a toast, of so many lines at most. A toast's own title has one line, in
/// which a phone would not show a sentence in full. The reference is floating. Main thread.
GtkWidget* makeToastTitle(const std::string& text, int lines);

} // namespace host::gtk
