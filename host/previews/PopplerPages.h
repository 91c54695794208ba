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

/// Answers the library's string as text and frees the string.
std::string takenText(char* text);
platform::Error pagesError(platform::PagesErrorCode code);

/// The pages of a document that Poppler has open.
class PopplerPages : public platform::PagedDocument {
public:
    using Page = Object<PopplerPage>;

    /// Answers a document that has pages, else the error. It takes over `problem`, the library's error.
    static platform::Result<Object<PopplerDocument>> checked(
        Object<PopplerDocument> document, GError* problem);

    explicit PopplerPages(Object<PopplerDocument> document);

    std::size_t pageCount() const override { return _count; }
    platform::Size pageSize(std::size_t index) const override;
    platform::Result<platform::Image> renderPage(
        std::size_t index, double pixelsPerPoint, const platform::Rect& part) const override;
    std::vector<platform::Rect> find(std::size_t index, const std::string& text) const override;
    platform::PageText textBetween(
        std::size_t index, platform::Point from, platform::Point to) const override;
    std::vector<platform::PageMark> marks(std::size_t index) const override;
    platform::PagesRights rights() const override;

    /// Runs a call with the document, which no other thread uses meanwhile. Answers the call's answer.
    template <typename Call>
    auto withDocument(Call&& call) const
    {
        const std::lock_guard lock(_mutex);
        return std::forward<Call>(call)(*_document);
    }
    /// Shows another state of the document, which has as many pages.
    void setDocument(Object<PopplerDocument> document);

    // These need a page whose document is locked.
    static Page page(PopplerDocument& document, std::size_t index);
    static platform::Size sizeOf(PopplerPage* page);
    /// Answers the rectangle from the top of the page. The library's rectangle counts upwards from the
    /// bottom.
    static platform::Rect fromBottom(const PopplerRectangle& place, double pageHeight);
    static PopplerRectangle toBottom(const platform::Rect& place, double pageHeight);
    /// The marks of a page, each with its handle. The identifier of a mark is its index in this order, in
    /// which invisible marks (`isSeen` is false) count as well.
    struct FoundMark {
        platform::PageMark mark;
        Object<PopplerAnnot> handle;
        bool isSeen = true;
    };
    static std::vector<FoundMark> foundMarks(PopplerPage* page);

private:
    mutable std::mutex _mutex; // the library's documents are not thread-safe
    Object<PopplerDocument> _document;
    std::size_t _count;
};

} // namespace host::previews
