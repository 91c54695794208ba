// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <gtk/gtk.h>

namespace host::gtk {

/// What a layer shows.
class LayerContent {
public:
    virtual ~LayerContent() = default;
    virtual GtkWidget* widget() const = 0;
    /// Puts the keyboard focus where the user goes on.
    virtual void focus() = 0;
};

} // namespace host::gtk
