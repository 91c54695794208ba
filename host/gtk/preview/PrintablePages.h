// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include "platform/Geometry.h"

#include <cairo.h>
#include <glib.h>

#include <memory>
#include <string>

namespace host::gtk {

/// The content of a document, ready to be drawn on paper, whose size is in points. Calls may take long. Any
/// thread may make them, one call at a time.
class PrintablePages {
public:
    virtual ~PrintablePages() = default;
    /// Divides the content into pages for this paper and answers their number, at least 1. It comes before
    /// draw().
    virtual int paginate(platform::Size paper) = 0;
    /// Draws a page; `page` counts from 0.
    virtual void draw(cairo_t* cairo, platform::Size paper, int page) = 0;
};

class PreviewModule;

enum class PrintableKind : int { Pdf, Picture, Text };

/// Reads a document, a PDF document with the libraries of the previews. It may take long; any thread. The
/// error says in a sentence that the file is damaged or too large.
platform::Result<std::shared_ptr<PrintablePages>> readPrintablePages(
    const std::string& path, PrintableKind kind, const PreviewModule& previews);

/// Scales the drawing to fit the paper, centred and never enlarged beyond `largest`.
void fitOnPaper(cairo_t* cairo, platform::Size paper, platform::Size content, double largest);
/// Answers the error for a document that cannot be printed: a message that is translated here, with the
/// library's own text. Takes over `error`; null means none.
platform::Error printingError(const char* words, GError* error);

} // namespace host::gtk
