// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"
#include "platform/PagedDocumentEditing.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PageDeck.h"
#include "screens/preview/PreviewView.h"

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {
class Queue;
} // namespace platform

namespace screens {

/// A document of pages to scroll through. Pages are drawn one at a time on a queue of the view's own, visible
/// ones first. Work for a document that is no longer shown is dropped. "Content" points are those of the page
/// deck.
class PreviewPagesView : public PreviewView {
public:
    static constexpr const char* kindName = "preview.pages";

    PreviewPagesView()
        : PreviewView(kindName)
    {
    }

    /// Shows a document. The place, the zoom and the search of an earlier document stay.
    void setDocument(std::shared_ptr<PagedDocument> document, Size firstPage);
    /// Replaces the document by another object with the very same content.
    void continueWith(std::shared_ptr<PagedDocument> document);
    const PageDeck& deck() const { return _deck; }

    bool canZoom() const override { return true; }
    bool canSearch() const override { return true; }
    bool canCopy() const override { return !_selection.empty(); }

    std::size_t pageCount() const { return _deck.pageCount(); }
    std::size_t currentPage() const { return _currentPage; } ///< counted from 0
    void goToPage(std::size_t page);
    /// Answers the top left corner of the part that was last visible, in content points, or nothing before
    /// anything was visible.
    std::optional<Point> visiblePlace() const;

    // Events up: the host reports what its peer shows.
    void userResized(double width, double scale);
    void userSees(const Rect& content);
    void peerShowsZoom(double zoom); ///< lays the pages out for it

    /// Answers the known matches of a page in page points.
    const std::vector<Rect>& matchesOn(std::size_t page) const;
    /// Answers the marked match in content points.
    std::optional<Rect> currentMatch() const;
    void showMatch(MatchStep step) override;

    /// The user dragged the pointer from one place of the content to another.
    void userSelects(Point from, Point to);
    void clearSelection();
    const std::map<std::size_t, PageText>& selection() const { return _selection; }
    std::string selectedText() const;

    /// A point on a page, in page points.
    struct PagePlace {
        std::size_t page = 0;
        Point point;
    };
    /// The user tapped on a place. The return key taps in the middle of the visible part.
    void userTaps(Point content);
    void userPressesEnter();
    void setOnTap(std::function<void(const PagePlace&)> callback) { _onTap = std::move(callback); }
    /// Finds the mark at a place, the topmost of several, or the nearest within a finger's reach. The
    /// callback comes later, and not when another document is shown by then.
    void findMark(const PagePlace& place, std::function<void(const std::optional<PageMark>&)> found);
    /// Answers the places to be marked, by page: the selected text, else the match of the search.
    std::map<std::size_t, std::vector<Rect>> chosenPlaces() const;

    // These serve while the document is being changed.
    /// The document's content has changed, so it is drawn again. Everything else stays.
    void documentDidChange();
    /// Sets the fields of the form, which are tinted. The field that is being filled in is scrolled into
    /// view.
    void setFields(std::vector<FormField> fields);
    const std::vector<FormField>& fields() const { return _fields; }
    void setActiveField(std::optional<std::uint32_t> field);
    const FormField* activeField() const; ///< null: none
    const FormField* fieldAt(const PagePlace& place) const;
    /// Answers whether the next tap chooses the place of a note.
    bool isPlacing() const { return _isPlacing; }
    void setPlacing(bool placing);
    /// The user pressed Ctrl+Z.
    void userWantsUndo();
    void setOnUndo(std::function<void()> callback) { _onUndo = std::move(callback); }

protected:
    void queryDidChange() override;

private:
    struct Match {
        std::size_t page, index;
        auto operator<=>(const Match&) const = default;
    };
    struct SelectionEnds {
        Point from, to;
    };

    void take(std::shared_ptr<PagedDocument> document);
    void readPageSizes();
    void drawNext();
    void drew(const PageDeck::Task& task, std::optional<Image> picture);
    void searchPage(std::size_t page, std::size_t remaining);
    void foundOnPage(std::size_t page, std::vector<Rect> places, std::size_t remaining);
    void mark(const Match& match);
    std::size_t rankOf(const Match& match) const;
    void publishSearch(bool isComplete);
    void readSelection();
    void reveal(const Rect& content);
    double fingerReachOn(std::size_t page) const; ///< page points
    void post(std::function<std::function<void(PreviewPagesView&)>(const PagedDocument&)> work,
        const std::shared_ptr<Queue>& queue);
    void needsDisplay();

    std::shared_ptr<PagedDocument> _document;
    PageDeck _deck;
    Rect _visible;
    std::size_t _currentPage = 0;
    unsigned _generation = 0; ///< number of the shown document; results for an older one are dropped
    bool _isDrawing = false, _isSelecting = false, _knowsSizes = false;
    std::shared_ptr<Queue> _drawing, _reading;

    unsigned _searchGeneration = 0;
    std::map<std::size_t, std::vector<Rect>> _matches; ///< only pages with matches
    std::optional<Match> _marked;
    std::size_t _matchCount = 0, _searchStart = 0;

    std::optional<SelectionEnds> _wantedSelection;
    unsigned _selectionGeneration =
        0; ///< number of the latest clearing; a selection read before it is dropped
    std::map<std::size_t, PageText> _selection;

    std::vector<FormField> _fields;
    std::optional<std::uint32_t> _activeField;
    bool _isPlacing = false;
    std::function<void(const PagePlace&)> _onTap;
    std::function<void()> _onUndo;
};

} // namespace screens
