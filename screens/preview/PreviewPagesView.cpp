// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewPagesView.h"

#include "platform/Dispatch.h"
#include "platform/Services.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

/// The search stops at so many matches, because nobody can use more.
constexpr std::size_t maxMatches = 10'000;
/// Further pages are left out, because the layout of all pages is computed at once.
constexpr std::size_t maxPages = 100'000;
constexpr double aboveMatch = 0.3; ///< share of the window's height above a match that is scrolled to

} // namespace

/// Runs work on the document on a queue. If the document is still shown afterwards, it runs the work's answer
/// on the main queue.
void PreviewPagesView::post(std::function<std::function<void(PreviewPagesView&)>(const PagedDocument&)> work,
    const std::shared_ptr<Queue>& queue)
{
    const auto self = std::static_pointer_cast<PreviewPagesView>(shared_from_this());
    queue->async([weak = std::weak_ptr(self), document = std::weak_ptr(_document), generation = _generation,
                     work = std::move(work), main = services().dispatch().mainQueue()] {
        // Only the view owns its document, so work for a document that is no longer shown is skipped.
        const auto open = document.lock();
        if (!open)
            return;
        main->async(weakly(weak, [generation, answer = work(*open)](PreviewPagesView& view) {
            if (view._generation == generation)
                answer(view);
        }));
    });
}

/// Shows another object for the document. Work for the one before is dropped.
void PreviewPagesView::take(std::shared_ptr<PagedDocument> document)
{
    auto& dispatch = services().dispatch();
    ++_generation;
    _drawing = dispatch.makeSerialQueue("preview pages");
    _reading = dispatch.makeSerialQueue("preview page texts");
    _isDrawing = _isSelecting = false;
    _document = std::move(document);
}

void PreviewPagesView::continueWith(std::shared_ptr<PagedDocument> document)
{
    take(std::move(document));
    _knowsSizes = false;
    if (!query().empty() && !searchState().isComplete)
        queryDidChange();
    drawNext();
}

void PreviewPagesView::setDocument(std::shared_ptr<PagedDocument> document, Size firstPage)
{
    take(std::move(document));
    const auto count = std::min(_document->pageCount(), maxPages);
    std::vector<Size> pages(count, firstPage);
    // Until a page's own size is known, it keeps its old size, else it has that of the first page.
    for (std::size_t page = 1; page < std::min(count, _deck.pageCount()); ++page) {
        const double points = _deck.pageFrame(0).width / firstPage.width;
        const auto frame = _deck.pageFrame(page);
        if (points > 0)
            pages[page] = {frame.width / points, frame.height / points};
    }
    _deck.forgetPictures();
    _deck.setPages(std::move(pages));
    _currentPage = _deck.currentPage(_visible);
    _selection.clear();
    _fields.clear();
    _activeField.reset();
    _isPlacing = false;
    _knowsSizes = count < 2;
    if (!query().empty())
        queryDidChange();
    peer().notify([](auto& peer) { peer.previewContentDidChange(); });
    stateDidChange();
    drawNext();
}

void PreviewPagesView::readPageSizes()
{
    const auto count = _deck.pageCount();
    post(
        [count](const PagedDocument& document) {
            std::vector<Size> sizes;
            for (std::size_t page = 0; page < count; ++page)
                sizes.push_back(document.pageSize(page));
            return [sizes](PreviewPagesView& view) {
                view._deck.setPages(sizes);
                view.peer().notify([](auto& peer) { peer.previewContentDidChange(); });
                view.drawNext();
            };
        },
        _reading);
}

void PreviewPagesView::needsDisplay()
{
    peer().notify([](auto& peer) { peer.previewNeedsDisplay(); });
}

void PreviewPagesView::userResized(double width, double scale)
{
    _deck.setWindow(width, scale);
}

void PreviewPagesView::peerShowsZoom(double zoom)
{
    _deck.setZoom(zoom);
    userZoomed(zoom);
}

void PreviewPagesView::userSees(const Rect& content)
{
    _visible = content;
    if (std::exchange(_currentPage, _deck.currentPage(_visible)) != _currentPage)
        stateDidChange();
    drawNext();
}

std::optional<Point> PreviewPagesView::visiblePlace() const
{
    return _visible.height > 0 ? std::optional(_visible.origin()) : std::nullopt;
}

void PreviewPagesView::goToPage(std::size_t page)
{
    if (page >= pageCount())
        return;
    auto place = _deck.pageFrame(page);
    place.y -= PageDeck::gap * zoom();
    place.height = _visible.height;
    peer().notify([&](auto& peer) { peer.previewShouldScrollTo(place); });
}

void PreviewPagesView::drawNext()
{
    if (_isDrawing || !_document || _visible.height <= 0)
        return;
    const auto task = _deck.nextTask(_visible);
    if (!task)
        return;
    _isDrawing = true;
    post(
        [task = *task](const PagedDocument& document) {
            auto drawn = document.renderPage(task.page, task.pixelsPerPoint, task.part);
            return [task, picture = std::move(drawn.value)](
                       PreviewPagesView& view) { view.drew(task, picture); };
        },
        _drawing);
}

void PreviewPagesView::drew(const PageDeck::Task& task, std::optional<Image> picture)
{
    _isDrawing = false;
    // The sizes of the other pages are read only now, because the first page that the user waits for comes
    // first.
    if (!std::exchange(_knowsSizes, true))
        readPageSizes();
    _deck.finish(task, std::move(picture), _visible);
    needsDisplay();
    drawNext();
}

const std::vector<Rect>& PreviewPagesView::matchesOn(std::size_t page) const
{
    static const std::vector<Rect> none;
    const auto found = _matches.find(page);
    return found == _matches.end() ? none : found->second;
}

void PreviewPagesView::queryDidChange()
{
    ++_searchGeneration;
    _matches.clear();
    _marked.reset();
    _matchCount = 0;
    needsDisplay();
    if (query().empty() || !_document)
        return;
    _searchStart = _currentPage;
    publishSearch(false);
    searchPage(_searchStart, pageCount());
}

void PreviewPagesView::searchPage(std::size_t page, std::size_t remaining)
{
    post(
        [page, remaining, text = query(), generation = _searchGeneration](const PagedDocument& document) {
            return [page, remaining, generation, places = document.find(page, text)](PreviewPagesView& view) {
                if (view._searchGeneration == generation)
                    view.foundOnPage(page, places, remaining);
            };
        },
        _reading);
}

void PreviewPagesView::foundOnPage(std::size_t page, std::vector<Rect> places, std::size_t remaining)
{
    _matchCount += places.size();
    const bool isFirst = !_marked && !places.empty();
    if (!places.empty()) {
        _matches[page] = std::move(places);
        needsDisplay();
    }
    if (isFirst)
        mark({page, 0});
    const bool isComplete = remaining <= 1 || _matchCount >= maxMatches;
    publishSearch(isComplete);
    if (!isComplete)
        searchPage((page + 1) % pageCount(), remaining - 1);
}

std::size_t PreviewPagesView::rankOf(const Match& match) const
{
    std::size_t before = 0;
    for (auto found = _matches.begin(); found != _matches.end() && found->first < match.page; ++found)
        before += found->second.size();
    return before + match.index + 1;
}

void PreviewPagesView::publishSearch(bool isComplete)
{
    setSearchState({_matchCount, _marked ? rankOf(*_marked) : 0, isComplete});
}

std::optional<Rect> PreviewPagesView::currentMatch() const
{
    if (!_marked)
        return std::nullopt;
    return _deck.toContent(_marked->page, matchesOn(_marked->page)[_marked->index]);
}

void PreviewPagesView::mark(const Match& match)
{
    _marked = match;
    needsDisplay();
    reveal(*currentMatch());
}

void PreviewPagesView::reveal(const Rect& content)
{
    auto place = content;
    const bool isSeen = place.y >= _visible.y && place.maxY() <= _visible.maxY() && place.x >= _visible.x
        && place.maxX() <= _visible.maxX();
    if (isSeen)
        return;
    place.y -= _visible.height * aboveMatch;
    place.height = _visible.height;
    peer().notify([&](auto& peer) { peer.previewShouldScrollTo(place); });
}

void PreviewPagesView::showMatch(MatchStep step)
{
    if (!_marked)
        return;
    auto next = *_marked;
    auto page = _matches.find(next.page);
    if (step == MatchStep::Next && ++next.index == page->second.size()) {
        page = std::next(page) == _matches.end() ? _matches.begin() : std::next(page);
        next = {page->first, 0};
    } else if (step == MatchStep::Previous && next.index-- == 0) {
        page = std::prev(page == _matches.begin() ? _matches.end() : page);
        next = {page->first, page->second.size() - 1};
    }
    mark(next);
    publishSearch(searchState().isComplete);
}

void PreviewPagesView::userSelects(Point from, Point to)
{
    if (to.y < from.y)
        std::swap(from, to);
    _wantedSelection = SelectionEnds{from, to};
    readSelection();
}

void PreviewPagesView::clearSelection()
{
    _wantedSelection.reset();
    ++_selectionGeneration;
    if (std::exchange(_selection, {}).empty())
        return;
    needsDisplay();
    stateDidChange();
}

/// Reads the latest selection that is wanted. While one selection is being read, earlier waiting ones are
/// dropped.
void PreviewPagesView::readSelection()
{
    if (_isSelecting || !_wantedSelection || !_document)
        return;
    const auto ends = *std::exchange(_wantedSelection, std::nullopt);
    const auto first = _deck.pageAt(ends.from.y), last = _deck.pageAt(ends.to.y);
    if (!first || !last)
        return;
    struct Part {
        std::size_t page;
        Point from, to;
    };
    std::vector<Part> parts;
    for (auto page = *first; page <= *last; ++page) {
        const auto frame = _deck.pageFrame(page);
        parts.push_back({page, _deck.toPage(page, page == *first ? ends.from : frame.origin()),
            _deck.toPage(page, page == *last ? ends.to : Point{frame.maxX(), frame.maxY()})});
    }
    _isSelecting = true;
    post(
        [parts, generation = _selectionGeneration](const PagedDocument& document) {
            std::map<std::size_t, PageText> found;
            for (const auto& part : parts)
                found[part.page] = document.textBetween(part.page, part.from, part.to);
            return [found, generation](PreviewPagesView& view) {
                view._isSelecting = false;
                if (view._selectionGeneration == generation)
                    view._selection = found;
                view.needsDisplay();
                view.stateDidChange();
                view.readSelection();
            };
        },
        _reading);
}

std::string PreviewPagesView::selectedText() const
{
    std::string text;
    for (const auto& [page, part] : _selection)
        text += (text.empty() || part.text.empty() ? "" : "\n") + part.text;
    return text;
}

} // namespace screens
