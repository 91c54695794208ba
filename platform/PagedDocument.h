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

/// The domain of errors that concern a document of pages.
namespace errorDomain {
inline constexpr std::string_view pages = "app.tarrow.Drive.pages"; ///< codes: PagesErrorCode
} // namespace errorDomain

/// Why a document of pages cannot be shown or changed although its file can be read.
enum class PagesErrorCode : int {
    Damaged = 1, ///< the content is no such document, or it has no pages
    PasswordRequired = 2, ///< the document is encrypted
    TooLarge = 3, ///< a page is asked for in more pixels than PagedDocument allows
    Refused = 4, ///< the document does not allow the change, or does not have what is to be changed
};

/// A stretch of a page's text. Both parts are empty where there is no text.
struct PageText {
    std::string text; ///< what it says, with line ends between lines
    std::vector<Rect> places; ///< the rectangles that it covers on the page, about one for each line
};

/// What somebody has added to a page: a marked text, a note or a drawing.
struct PageMark {
    /// What it is. Marks of the kind Other are shown, but they cannot be made.
    enum class Kind { Highlight, Underline, Note, Other };

    std::uint32_t id = 0; ///< tells the marks of a page apart and stays the same while others come and go
    Kind kind = Kind::Other;
    Rect place; ///< the rectangle around all of it, on its page
    std::string text; ///< what the mark says; may be empty
    bool isLocked = false; ///< its author does not want it changed, so edits of it are refused
    bool operator==(const PageMark&) const = default;
};

/// What the author of a document allows to be done to it.
struct PagesRights {
    bool canFillForms = false; ///< fields may be filled in
    bool canMark = false; ///< marks may be added, changed and removed; whoever may do that may fill in fields
};

/// A document of pages of fixed size, such as a PDF document, that is open for reading. Lengths are the
/// document's own points (1/72 inch), counted from the top left corner of a page; y grows downwards. Pages
/// are numbered from 0, and every page that is asked for must be less than `pageCount`. Any thread may call;
/// a call takes as long as its work, and calls on one document wait for each other, so only `pageCount` is
/// for the main thread.
class PagedDocument {
public:
    /// The most pixels that one picture of a page may have: 128 MiB.
    static constexpr int maxRenderedPixels = 32 << 20;
    static constexpr int longestRenderedSide = 32'767; ///< pixels

    virtual ~PagedDocument() = default;

    /// The number of pages, at least one. It does not change and costs nothing.
    virtual std::size_t pageCount() const = 0;
    /// Answers the size of a page. It is never empty: a page that gives no usable size has that of a sheet of
    /// A4 paper, and no side is longer than 14,400 points.
    virtual Size pageSize(std::size_t page) const = 0;
    /// Draws a part of a page on white paper, in so many pixels to a point. The picture's size is that of the
    /// part, rounded to whole pixels; what lies outside of the page is white. Errors:
    /// PagesErrorCode::TooLarge, also for an empty picture; PagesErrorCode::Damaged.
    virtual Result<Image> renderPage(std::size_t page, double pixelsPerPoint, const Rect& part) const = 0;
    /// Answers the rectangles where a text stands on a page, whatever its letter case, from top to bottom;
    /// none for an empty text.
    virtual std::vector<Rect> find(std::size_t page, const std::string& text) const = 0;
    /// Answers the text between two points of a page, as a pointer that is dragged from one to the other
    /// selects it.
    virtual PageText textBetween(std::size_t page, Point from, Point to) const = 0;
    /// Answers the marks of a page that can be seen, the topmost last.
    virtual std::vector<PageMark> marks(std::size_t page) const = 0;
    /// Answers what the document's author allows.
    virtual PagesRights rights() const = 0;
};

class PagedDocumentEditing;

/// Opens documents of pages. Any thread may call; a call waits for the disk, so it is not for the main
/// thread.
class PagedDocumentOpener {
public:
    virtual ~PagedDocumentOpener() = default;

    /// Opens the document in the file at a path, which must be a regular file, and reads as much as is needed
    /// to know its pages. The file stays open until the document ends. Errors: FileErrorCode::NoSuchFile when
    /// nothing is there (a promise is nothing), PagesErrorCode::Damaged or PasswordRequired, or the system's
    /// error.
    virtual Result<std::shared_ptr<PagedDocument>> open(const std::string& path) const = 0;
    /// Opens a document of these bytes to be changed; the bytes are kept, and no file is written. Errors: as
    /// open(); Damaged also for a document that can be shown only after a repair, because what is appended to
    /// it would refer to what is not there.
    virtual Result<std::shared_ptr<PagedDocumentEditing>> openForEditing(
        std::shared_ptr<const std::string> bytes) const = 0;
};

} // namespace platform
