// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"

#include <poppler.h>

#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

namespace host::previews {

template <typename T>
struct Unref {
    void operator()(T* object) const { g_object_unref(object); }
};
template <typename T>
using Object = std::unique_ptr<T, Unref<T>>;

/// The library's string as text; it is freed.
std::string takenText(char* text);
platform::Error pagesError(platform::PagesErrorCode code);

/// The pages of a document that Poppler has open.
class PopplerPages : public platform::PagedDocument {
public:
    using Page = Object<PopplerPage>;

    /// A document that has pages; `problem`, which this frees, is why there is none.
    static platform::Result<Object<PopplerDocument>> checked(
        Object<PopplerDocument> document, GError* problem);

    explicit PopplerPages(Object<PopplerDocument> document);

    std::size_t pageCount() const override { return _count; }
    platform::Size pageSize(std::size_t page) const override;
    platform::Result<platform::Image> renderPage(
        std::size_t page, double pixelsPerPoint, const platform::Rect& part) const override;
    std::vector<platform::Rect> find(std::size_t page, const std::string& text) const override;
    platform::PageText textBetween(std::size_t page, platform::Point from, platform::Point to) const override;
    std::vector<platform::PageMark> marks(std::size_t page) const override;
    platform::PagesRights rights() const override;

    /// Runs a call with the document, which nobody else uses meanwhile; answers what the call answers.
    template <typename Call>
    auto withDocument(Call&& call) const
    {
        const std::lock_guard lock(_mutex);
        return std::forward<Call>(call)(*_document);
    }
    /// Shows another state of the document, of as many pages.
    void setDocument(Object<PopplerDocument> document);

    // For a page that is being used with its document.
    static Page page(PopplerDocument& document, std::size_t index);
    static platform::Size sizeOf(PopplerPage* page);
    /// From the library's rectangle, which counts upwards from the bottom of the page.
    static platform::Rect fromBottom(const PopplerRectangle& place, double pageHeight);
    static PopplerRectangle toBottom(const platform::Rect& place, double pageHeight);
    /// The marks of a page, each with its handle. Their identifiers are their places in this order, in which
    /// those stand, too, that nobody sees (`isSeen` is false).
    struct FoundMark {
        platform::PageMark mark;
        Object<PopplerAnnot> handle;
        bool isSeen = true;
    };
    static std::vector<FoundMark> foundMarks(PopplerPage* page);

private:
    mutable std::mutex _mutex; // the library's documents know no threads
    Object<PopplerDocument> _document;
    std::size_t _count;
};

} // namespace host::previews
