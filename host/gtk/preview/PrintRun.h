// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/preview/PrintablePages.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace host::gtk {

/// Where pages go: to the printer that the person chooses in a dialog over a window, or into a PDF file.
struct PrintTarget {
    GtkWindow* dialogParent = nullptr;
    std::string file{}; ///< empty: ask
};

/// Prints pages under a name. `ended` is called once, with what went wrong, or nothing when it was printed or
/// the person cancelled. Main thread.
void startPrinting(std::shared_ptr<PrintablePages> pages, const std::string& name, const PrintTarget& target,
    std::function<void(std::optional<platform::Error>)> ended);

} // namespace host::gtk
