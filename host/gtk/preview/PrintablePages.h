// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <gtk/gtk.h>

#include <memory>
#include <string>

namespace host::gtk {

/// The content of a document, ready to be drawn on paper.
class PrintablePages {
public:
    virtual ~PrintablePages() = default;
    /// Divides the content into pages for this paper and answers their number, at least 1. Main thread,
    /// before draw().
    virtual int paginate(GtkPrintContext* paper) = 0;
    /// Draws a page; `page` counts from 0. Main thread.
    virtual void draw(GtkPrintContext* paper, int page) = 0;
};

class PreviewModule;

enum class PrintableKind : int { Pdf, Picture, Text };

/// Reads a document, a PDF document with the libraries of the previews. It may take long; any thread. The
/// error says in a sentence that the file is damaged or too large.
platform::Result<std::shared_ptr<PrintablePages>> readPrintablePages(
    const std::string& path, PrintableKind kind, const PreviewModule& previews);

/// Scales the drawing to fit the paper, centred and never enlarged beyond `largest`.
void fitOnPaper(GtkPrintContext* paper, double width, double height, double largest);
/// Answers the error for a document that cannot be printed: a message that is translated here, with the
/// library's own text. Takes over `error`; null means none.
platform::Error printingError(const char* words, GError* error);

} // namespace host::gtk
