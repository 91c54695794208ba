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

enum class PrintableKind : int { Pdf, Picture, Text };

/// Reads a document. Any thread; may take long. Errors: what the file is damaged or too large for, in words.
platform::Result<std::shared_ptr<PrintablePages>> readPrintablePages(
    const std::string& path, PrintableKind kind);

} // namespace host::gtk
