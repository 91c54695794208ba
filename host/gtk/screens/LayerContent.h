// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// The content of a layer.
class LayerContent {
public:
    virtual ~LayerContent() = default;
    virtual GtkWidget* widget() const = 0;
    /// Gives the keyboard focus to the widget with which the user continues.
    virtual void focus() = 0;
};

} // namespace host::gtk
