// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"
#include "platform/TextDecoder.h"

#include <memory>
#include <string>

namespace screens {
class PreviewMediaView;
class PreviewTextView;
} // namespace screens

namespace host::gtk {

class PreviewNative;
class PrintablePages;

/// What shows documents with large libraries: documents of pages, sources in colours, films. It comes from a
/// module that is loaded when it is first wanted, so that the start does not pay for them.
class PreviewLibraries {
public:
    virtual ~PreviewLibraries() = default;

    /// Any thread.
    virtual const platform::PagedDocumentOpener& pagedDocuments() const = 0;
    virtual const platform::TextDecoder& textDecoder() const = 0;
    /// Any thread; may take long. Errors: why the document cannot be printed, in words.
    virtual platform::Result<std::shared_ptr<PrintablePages>> readPrintablePdf(
        const std::string& path) const = 0;
    /// The native sides of views, not started yet. Main thread.
    virtual std::shared_ptr<PreviewNative> makeTextNative(
        const std::shared_ptr<screens::PreviewTextView>& view) const = 0;
    virtual std::shared_ptr<PreviewNative> makeMediaNative(
        const std::shared_ptr<screens::PreviewMediaView>& view) const = 0;
};

/// The one function that the module is asked for, and its name.
using MakePreviewLibraries = void(std::shared_ptr<PreviewLibraries>& made);
inline constexpr const char* makePreviewLibrariesName = "trwMakePreviewLibraries";

} // namespace host::gtk
