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

/// A document of pages to scroll through. Pages are drawn one at a time on a queue of the view's own, those
/// that are seen first; work for a document that is no longer shown is dropped. "Content" points are those of
/// the page deck.
class PreviewPagesView : public PreviewView {
public:
    static constexpr const char* kindName = "preview.pages";

    PreviewPagesView()
        : PreviewView(kindName)
    {
    }

    /// Shows a document. Where one was shown before, the place, the zoom and the search stay.
    void setDocument(std::shared_ptr<PagedDocument> document, Size firstPage);
    /// Goes on with another object that holds the very same content.
    void continueWith(std::shared_ptr<PagedDocument> document);
    const PageDeck& deck() const { return _deck; }

    bool canZoom() const override { return true; }
    bool canSearch() const override { return true; }
    bool canCopy() const override { return !_selection.empty(); }

    std::size_t pageCount() const { return _deck.pageCount(); }
    std::size_t currentPage() const { return _currentPage; } ///< counted from 0
    void goToPage(std::size_t page);
    /// The corner of what was seen last, in the content; nothing before it was seen.
    std::optional<Point> visiblePlace() const;

    // Events up.
    void userResized(double width, double scale);
    void userSees(const Rect& content);
    void nativeShowsZoom(double zoom); ///< lays the pages out for it

    /// The matches of a page that are known so far, in page points.
    const std::vector<Rect>& matchesOn(std::size_t page) const;
    /// The match that is marked, in the content.
    std::optional<Rect> currentMatch() const;
    void showMatch(MatchStep step) override;

    /// The pointer was drawn from one place of the content to another.
    void userSelects(Point from, Point to);
    void clearSelection();
    const std::map<std::size_t, PageText>& selection() const { return _selection; }
    std::string selectedText() const;

    /// A place on a page.
    struct PagePlace {
        std::size_t page = 0;
        Point point;
    };
    /// The person tapped on a place; Enter is a tap in the middle of what is seen.
    void userTaps(Point content);
    void userPressesEnter();
    void setOnTap(std::function<void(const PagePlace&)> callback) { _onTap = std::move(callback); }
    /// The mark at a place, the topmost of several, or the nearest that a finger may mean; called later, and
    /// not when another document is shown by then.
    void findMark(const PagePlace& place, std::function<void(const std::optional<PageMark>&)> found);
    /// The texts that are marked by the person, by page: what is selected, else the match of the search.
    std::map<std::size_t, std::vector<Rect>> chosenPlaces() const;

    // While the document is being changed.
    /// What is shown has changed in itself: it is drawn anew, and all else stays.
    void documentDidChange();
    /// The fields of its form, which are tinted, and the one that is being filled in, which is brought into
    /// sight.
    void setFields(std::vector<FormField> fields);
    const std::vector<FormField>& fields() const { return _fields; }
    void setActiveField(std::optional<std::uint32_t> field);
    const FormField* activeField() const; ///< null: none
    const FormField* fieldAt(const PagePlace& place) const;
    /// Whether the next tap says where something belongs.
    bool isPlacing() const { return _isPlacing; }
    void setPlacing(bool placing);
    /// Ctrl+Z was pressed.
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
    unsigned _generation = 0; ///< of the document; what arrives for an older one is dropped
    bool _isDrawing = false, _isSelecting = false, _knowsSizes = false;
    std::shared_ptr<Queue> _drawing, _reading;

    unsigned _searchGeneration = 0;
    std::map<std::size_t, std::vector<Rect>> _matches; ///< only pages that have some
    std::optional<Match> _marked;
    std::size_t _matchCount = 0, _searchStart = 0;

    std::optional<SelectionEnds> _wantedSelection;
    unsigned _selectionGeneration = 0; ///< of the latest clearing
    std::map<std::size_t, PageText> _selection;

    std::vector<FormField> _fields;
    std::optional<std::uint32_t> _activeField;
    bool _isPlacing = false;
    std::function<void(const PagePlace&)> _onTap;
    std::function<void()> _onUndo;
};

} // namespace screens
