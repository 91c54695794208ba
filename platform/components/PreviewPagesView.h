#pragma once

#include "platform/PagedDocument.h"
#include "platform/components/PageDeck.h"
#include "platform/components/PreviewView.h"

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {
class Queue;
} // namespace platform

namespace platform::components {

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

    void readPageSizes();
    void drawNext();
    void drew(const PageDeck::Task& task, std::optional<Image> picture);
    void searchPage(std::size_t page, std::size_t remaining);
    void foundOnPage(std::size_t page, std::vector<Rect> places, std::size_t remaining);
    void mark(const Match& match);
    std::size_t rankOf(const Match& match) const;
    void publishSearch(bool isComplete);
    void readSelection();
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
};

} // namespace platform::components
