// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Geometry.h"
#include "platform/Image.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {

namespace errorDomain {
inline constexpr std::string_view pages = "app.tarrow.Drive.pages"; ///< codes: PagesErrorCode
} // namespace errorDomain

enum class PagesErrorCode : int {
    Damaged = 1, ///< the content is no such document, or has no pages
    PasswordRequired = 2,
    TooLarge = 3, ///< a page is asked for in more pixels than PagedDocument::maxRenderedPixels
    Refused = 4, ///< the document does not allow the change, or has not what is to be changed
};

/// A stretch of a page's text: what it says, and the rectangles that it covers.
struct PageText {
    std::string text;
    std::vector<Rect> places;
};

/// What somebody has added to a page: a marked text, a note, a drawing.
struct PageMark {
    enum class Kind { Highlight, Underline, Note, Other };

    std::uint32_t id = 0; ///< one on its page, also when others come and go
    Kind kind = Kind::Other;
    Rect place; ///< around all of it
    std::string text; ///< what it says; may be empty
    bool isLocked = false; ///< it is not to be changed
    bool operator==(const PageMark&) const = default;
};

/// What the author of a document allows to be done to it.
struct PagesRights {
    bool canFillForms = false, canMark = false;
};

/// A document of pages of fixed size, open for reading. Lengths are the document's own points (1/72 inch),
/// from the top left corner of a page. Any thread; every call takes as long as its work, and calls on one
/// document wait for each other. Page numbers are below `pageCount`.
class PagedDocument {
public:
    static constexpr int maxRenderedPixels = 32 << 20; ///< 128 MiB of picture

    virtual ~PagedDocument() = default;

    virtual std::size_t pageCount() const = 0;
    /// Never empty; a page without a size has that of a sheet of paper.
    virtual Size pageSize(std::size_t page) const = 0;
    /// A part of a page on white paper. Errors: PagesErrorCode.
    virtual Result<Image> renderPage(std::size_t page, double pixelsPerPoint, const Rect& part) const = 0;
    /// Where a text stands on a page, whatever its case, from top to bottom.
    virtual std::vector<Rect> find(std::size_t page, const std::string& text) const = 0;
    /// The text that a pointer drawn from one point to another passes over.
    virtual PageText textBetween(std::size_t page, Point from, Point to) const = 0;
    /// What was added to a page, the topmost last.
    virtual std::vector<PageMark> marks(std::size_t page) const = 0;
    virtual PagesRights rights() const = 0;
};

class PagedDocumentEditing;

/// Opens documents of pages. Any thread.
class PagedDocumentOpener {
public:
    virtual ~PagedDocumentOpener() = default;

    /// The document in the file at a path. Reads as much as is needed to know its pages. Errors:
    /// FileErrorCode::NoSuchFile, PagesErrorCode, or the system's error.
    virtual Result<std::shared_ptr<PagedDocument>> open(const std::string& path) const = 0;
    /// A document of these bytes, to be changed. Errors: PagesErrorCode, Damaged also for one that can be
    /// shown only after a repair.
    virtual Result<std::shared_ptr<PagedDocumentEditing>> openForEditing(
        std::shared_ptr<const std::string> bytes) const = 0;
};

} // namespace platform
