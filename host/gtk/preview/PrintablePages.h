// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <gtk/gtk.h>

#include <memory>
#include <string>

namespace host::gtk {

/// A document's content, ready to be drawn on paper.
class PrintablePages {
public:
    virtual ~PrintablePages() = default;
    /// Divides the content into pages for this paper; their number, at least 1. Main thread, before draw().
    virtual int paginate(GtkPrintContext* paper) = 0;
    /// `page` counts from 0. Main thread.
    virtual void draw(GtkPrintContext* paper, int page) = 0;
};

class PreviewModule;

enum class PrintableKind : int { Pdf, Picture, Text };

/// Reads a document; a PDF document with the libraries of the previews. Any thread; may take long. Errors:
/// what the file is damaged or too large for, in words.
platform::Result<std::shared_ptr<PrintablePages>> readPrintablePages(
    const std::string& path, PrintableKind kind, const PreviewModule& previews);

/// Scales what is drawn next to fit the paper, centred, never enlarged beyond `largest`.
void fitOnPaper(GtkPrintContext* paper, double width, double height, double largest);
/// Why a document cannot be printed: words that are looked up, with what a library says. Takes that over;
/// null: none.
platform::Error printingError(const char* words, GError* error);

} // namespace host::gtk
