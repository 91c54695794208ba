// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"
#include "platform/TextDecoder.h"
#include "platform/ThumbnailMaker.h"

#include <memory>
#include <string>

namespace screens {
class PreviewMediaView;
class PreviewTextView;
} // namespace screens

namespace host::gtk {

class PreviewPeer;
class PrintablePages;

/// The parts of the preview that need large libraries: documents of pages, coloured source code, films. They
/// come from a module that is loaded on first use, so that the start of the program does not pay for the
/// libraries.
class PreviewLibraries {
public:
    virtual ~PreviewLibraries() = default;

    /// May be called on any thread.
    virtual const platform::PagedDocumentOpener& pagedDocuments() const = 0;
    virtual const platform::TextDecoder& textDecoder() const = 0;
    virtual const platform::ThumbnailMaker& thumbnails() const = 0;
    /// Reads a PDF document to be printed. It may take long; any thread. The error says in a sentence why the
    /// document cannot be printed.
    virtual platform::Result<std::shared_ptr<PrintablePages>> readPrintablePdf(
        const std::string& path) const = 0;
    /// Make the peers of views, which are not started yet. Main thread.
    virtual std::shared_ptr<PreviewPeer> makeTextPeer(
        const std::shared_ptr<screens::PreviewTextView>& view) const = 0;
    virtual std::shared_ptr<PreviewPeer> makeMediaPeer(
        const std::shared_ptr<screens::PreviewMediaView>& view) const = 0;
};

/// The one function that the module exports, and its name.
using MakePreviewLibraries = void(std::shared_ptr<PreviewLibraries>& made);
inline constexpr const char* makePreviewLibrariesName = "trwMakePreviewLibraries";

} // namespace host::gtk
