// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PrintablePages.h"

#include <gtk/gtk.h>

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace host::gtk {

/// The target of a print: the printer that the user chooses in a dialog over a window, or a PDF file.
struct PrintTarget {
    GtkWindow* dialogParent = nullptr;
    std::string file{}; ///< empty: show the dialog
};

/// Prints pages under a name. They are laid out and drawn off the main thread. `ended` is called once, with
/// the error, or with nothing when the pages were printed or the user cancelled. Main thread.
void startPrinting(std::shared_ptr<PrintablePages> pages, const std::string& name, const PrintTarget& target,
    std::function<void(std::optional<platform::Error>)> ended);

} // namespace host::gtk
