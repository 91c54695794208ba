// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/Window.h"

#include <gtk/gtk.h>

#include <memory>

namespace host::gtk {

/// Lets files of other programs be dropped on a window, and pasted by Ctrl+V while no text has the keyboard.
/// The model is asked whether it takes them (kit::Window::takesFiles()). What the program itself drags is not
/// taken. Files without a path on this machine are left out, and the user is told.
void connectFileOffers(GtkWidget* window, const std::shared_ptr<kit::Window>& model);

} // namespace host::gtk
