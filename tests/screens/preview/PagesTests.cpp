// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/PagedDocument.h"
#include "screens/preview/PageDeck.h"
#include "screens/preview/PreviewPagesView.h"
#include "tests/screens/support/ScreensFixture.h"
#include "tests/support/SimplePdf.h"

#include <set>

using namespace platform;
using namespace screens;
using namespace testing;
using namespace testing_support;

namespace {

constexpr Size sheet{200, 300};

PageDeck deckOf(std::size_t pages, Size size = sheet)
{
    PageDeck deck;
    deck.setWindow(200 + 2 * PageDeck::gap, 1);
    deck.setPages(std::vector<Size>(pages, size));
    return deck;
}

Image drawn(const PageDeck::Task& task)
{
    return Image::fromPixels(static_cast<int>(task.part.width * task.pixelsPerPoint),
        static_cast<int>(task.part.height * task.pixelsPerPoint), 1, {});
}

TEST(PageDeckTest, PlacesPagesBelowEachOtherAndGrowsWithTheZoom)
{
    auto deck = deckOf(3);
    EXPECT_EQ(deck.pageFrame(0), (Rect{12, 12, 200, 300}));
    EXPECT_EQ(deck.pageFrame(2).y, 12 + 2 * 312);
    EXPECT_EQ(deck.contentSize(), (Size{224, 12 + 3 * 312}));
    deck.setZoom(2);
    EXPECT_EQ(deck.contentSize(), (Size{448, 2 * (12 + 3 * 312)}));
    EXPECT_EQ(deck.pageFrame(1), (Rect{24, 2 * (12 + 312), 400, 600}));
    EXPECT_EQ(deck.toPage(1, {124, 748}), (Point{50, 50}));
    EXPECT_EQ(deck.toContent(1, {50, 50, 10, 20}), (Rect{124, 748, 20, 40}));

    // A narrow page is centred, and a wide window does not enlarge pages beyond a limit.
    deck.setZoom(1);
    deck.setPages({sheet, {100, 300}});
    EXPECT_EQ(deck.pageFrame(1).x, 62);
    deck.setWindow(2000, 1);
    EXPECT_EQ(deck.pageFrame(0).width, PageDeck::widestFit);
    EXPECT_EQ(deck.pageFrame(0).midX(), 1000);

    EXPECT_FALSE(PageDeck().pageAt(5));
    EXPECT_EQ(deckOf(3).pageAt(-5), 0U);
    EXPECT_EQ(deckOf(3).pageAt(1e6), 2U);
    EXPECT_EQ(deckOf(3).currentPage({0, 300, 224, 300}), 1U);
}

TEST(PageDeckTest, DrawsAVeryLongPageCoarselyAndWhatIsSeenOfItFinely)
{
    auto deck = deckOf(1, {50, 14'400});
    const Rect seen{0, 1000, 224, 400};
    const auto whole = deck.nextTask(seen);
    ASSERT_TRUE(whole && !whole->isDetail);
    EXPECT_LE(whole->part.height * whole->pixelsPerPoint, PageDeck::longestPictureSide);
    EXPECT_LE(PageDeck::longestPictureSide, PagedDocument::longestRenderedSide);
    deck.finish(*whole, drawn(*whole), seen);
    const auto detail = deck.nextTask(seen);
    ASSERT_TRUE(detail && detail->isDetail);
    EXPECT_EQ(detail->pixelsPerPoint, 4);
}

TEST(PageDeckTest, DrawsWhatIsSeenFirstAndThenItsNeighbours)
{
    auto deck = deckOf(10);
    const Rect seen{0, 12 + 4 * 312, 224, 400};
    std::vector<std::size_t> order;
    while (const auto task = deck.nextTask(seen)) {
        order.push_back(task->page);
        // The sixth page is damaged and must not be tried for ever.
        deck.finish(*task, task->page == 5 ? std::nullopt : std::optional(drawn(*task)), seen);
    }
    EXPECT_THAT(order, ElementsAre(4, 5, 6, 3));
    EXPECT_TRUE(deck.isBroken(5));
    EXPECT_FALSE(deck.picture(5));
    EXPECT_TRUE(deck.picture(4));

    // Another size needs other pictures. Until they are drawn, the old ones are shown.
    deck.setZoom(2);
    EXPECT_EQ(deck.nextTask({0, deck.pageFrame(4).y, 224, 400})->pixelsPerPoint, 2);
    EXPECT_TRUE(deck.picture(4));
    // All pages of a changed document are drawn again, also the broken one.
    deck.setZoom(1);
    deck.forgetPictures();
    deck.setPages(std::vector<Size>(6, sheet));
    EXPECT_EQ(deck.nextTask(seen)->page, 4U);
    EXPECT_FALSE(deck.isBroken(5));
    EXPECT_FALSE(deck.picture(6));
}

TEST(PageDeckTest, KeepsPicturesWithinItsLimits)
{
    auto deck = deckOf(400, {1000, 1500});
    deck.setWindow(1000 + 2 * PageDeck::gap, 2);
    std::size_t most = 0;
    for (std::size_t page = 0; page < 400; page += 7) {
        const auto frame = deck.pageFrame(page);
        for (auto task = deck.nextTask(frame); task; task = deck.nextTask(frame)) {
            EXPECT_LE(task->part.width * task->part.height * task->pixelsPerPoint * task->pixelsPerPoint,
                2 * PageDeck::maxPagePixels * 1.01);
            deck.finish(*task, drawn(*task), frame);
        }
        EXPECT_TRUE(deck.picture(page));
        std::size_t bytes = 0;
        for (std::size_t kept = 0; kept < 400; ++kept)
            bytes += deck.picture(kept) ? deck.picture(kept)->pixels().size() * 4 : 0;
        most = std::max(most, bytes);
    }
    // The visible pages may together exceed the limit.
    EXPECT_LE(most, PageDeck::maxPictureBytes + 2 * 24'000'000);

    deck.setZoom(8);
    const Rect closeUp{1000, deck.pageFrame(3).y + 100, 1024, 700};
    std::set<bool> details;
    for (auto task = deck.nextTask(closeUp); task; task = deck.nextTask(closeUp)) {
        details.insert(task->isDetail);
        deck.finish(*task, drawn(*task), closeUp);
    }
    EXPECT_THAT(details, ElementsAre(false, true));
    ASSERT_TRUE(deck.detail());
    const auto part = deck.toContent(3, deck.detail()->task.part);
    EXPECT_NEAR(part.y, closeUp.y, 1);
    EXPECT_NEAR(part.width, closeUp.width, 1);
}

/// Records the places to which it was asked to scroll.
struct Peer : PreviewViewObserver {
    void previewShouldScrollTo(const Rect& content) override { places.push_back(content); }
    std::vector<Rect> places;
};

class Pages : public ScreensFixture {
protected:
    Pages()
    {
        view->setPreviewObserver(peer);
        view->userResized(224, 1);
    }
    std::shared_ptr<PagedDocument> write(const std::vector<std::string>& texts)
    {
        const auto path = drive.writeDocument("Plan.pdf", simplePdf(texts)).path();
        const auto opened = services().pagedDocumentOpener().open(path);
        return opened ? *opened.value : nullptr;
    }
    void show(const std::vector<std::string>& texts)
    {
        view->setDocument(write(texts), sheet);
        drive.dispatch->runUntilIdle();
    }
    void see(double y)
    {
        view->userSees({0, y, 224, 300});
        drive.dispatch->runUntilIdle();
    }
    bool hasInk(std::size_t page) const
    {
        const auto* picture = view->deck().picture(page);
        return picture
            && std::ranges::any_of(picture->pixels(), [](auto pixel) { return pixel == 0xFF000000; });
    }

    std::shared_ptr<Peer> peer = std::make_shared<Peer>();
    std::shared_ptr<PreviewPagesView> view = std::make_shared<PreviewPagesView>();
};

TEST_F(Pages, FindsTextsFromThePageThatIsReadAndGoesAround)
{
    show({"needle", "hay", "Needle needle", "hay"});
    see(view->deck().pageFrame(1).y);
    view->setQuery("needle");
    EXPECT_FALSE(view->searchState().isComplete);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(view->searchState(), (SearchState{3, 2, true}));
    ASSERT_EQ(peer->places.size(), 1U);
    const auto match = *view->currentMatch();
    EXPECT_EQ(view->deck().pageAt(match.midY()), 2U);
    // The line is 50 points from the left and 200 from the bottom of the page.
    EXPECT_NEAR(match.x - view->deck().pageFrame(2).x, 50, 2);
    EXPECT_NEAR(match.maxY() - view->deck().pageFrame(2).y, 100, 8);

    std::vector<std::size_t> steps;
    for (const auto step : {MatchStep::Next, MatchStep::Next, MatchStep::Previous, MatchStep::Previous}) {
        view->showMatch(step);
        steps.push_back(view->searchState().current);
    }
    EXPECT_THAT(steps, ElementsAre(3, 1, 3, 2));

    view->setQuery("nowhere");
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(view->searchState(), (SearchState{0, 0, true}));
    view->showMatch(MatchStep::Next);
    view->setQuery("");
    EXPECT_TRUE(view->matchesOn(2).empty());
}

TEST_F(Pages, KeepsPlaceZoomAndSearchWhenTheDocumentChanges)
{
    show({"one", "two", "three"});
    view->peerShowsZoom(2);
    see(view->deck().pageFrame(2).y);
    view->setQuery("three");
    drive.dispatch->runUntilIdle();
    peer->places.clear();

    show({"one", "two", "three", "three again"});
    EXPECT_EQ(view->pageCount(), 4U);
    EXPECT_EQ(view->currentPage(), 2U);
    EXPECT_EQ(view->zoom(), 2);
    EXPECT_EQ(view->searchState().matches, 2U);
    EXPECT_TRUE(peer->places.empty());
    EXPECT_TRUE(hasInk(2));
}

TEST_F(Pages, SelectsTextAcrossPages)
{
    show({"first", "second", "third"});
    see(0);
    const auto from = view->deck().toContent(0, {40, 60, 1, 1}).origin();
    const auto to = view->deck().toContent(1, {190, 150, 1, 1}).origin();
    view->userSelects(to, from);
    view->userSelects(to, from);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(view->selectedText(), "first\nsecond");
    EXPECT_FALSE(view->selection().at(0).places.empty());
    EXPECT_TRUE(view->canCopy());

    view->userSelects(from, to);
    view->clearSelection();
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(view->selectedText(), "");
    EXPECT_FALSE(view->canCopy());
}

TEST_F(Pages, StopsWorkingOnADocumentThatIsNoLongerShown)
{
    show({"one", "two"});
    const std::weak_ptr<PreviewPagesView> weak = view;
    view->userSees({0, 0, 224, 300});
    view->setQuery("one");
    view.reset();
    EXPECT_TRUE(weak.expired());
    drive.dispatch->runUntilIdle();
}

TEST_F(Pages, DrawsNoMorePixelsThanItsLimitAllows)
{
    const auto document = write({"page"});
    EXPECT_EQ(document->renderPage(0, 1000, {0, 0, 200, 300}).error->code(),
        static_cast<int>(PagesErrorCode::TooLarge));
    EXPECT_EQ(document->renderPage(0, 0.5, {0, 0, 200, 300}).value->pixelHeight(), 150);
    EXPECT_EQ(document->renderPage(0, 10, {0, 0, 1, 3277}).error->code(),
        static_cast<int>(PagesErrorCode::TooLarge))
        << "it would be blank";
}

} // namespace
