// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PageDeck.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace screens {

namespace {

constexpr double narrowestWindow = 64; ///< points; used while there is no window yet

std::size_t bytesOf(const std::optional<Image>& picture)
{
    return picture ? picture->pixels().size() * 4 : 0;
}

bool isNear(double value, double other)
{
    return std::abs(value - other) < 0.01 * other;
}

Rect common(const Rect& a, const Rect& b)
{
    const double x = std::max(a.x, b.x), y = std::max(a.y, b.y);
    return {x, y, std::max(0.0, std::min(a.maxX(), b.maxX()) - x),
        std::max(0.0, std::min(a.maxY(), b.maxY()) - y)};
}

bool covers(const Rect& outer, const Rect& inner)
{
    constexpr double slack = 0.5;
    return outer.x <= inner.x + slack && outer.y <= inner.y + slack && outer.maxX() >= inner.maxX() - slack
        && outer.maxY() >= inner.maxY() - slack;
}

} // namespace

void PageDeck::setPages(std::vector<Size> pages)
{
    std::erase_if(_kept, [&](const auto& entry) {
        return entry.first >= pages.size() || pages[entry.first] != _pages[entry.first];
    });
    _detail.reset();
    _pages = std::move(pages);
    _widest = 1;
    for (const auto& page : _pages)
        _widest = std::max(_widest, page.width);
    place();
}

void PageDeck::setWindow(double width, double scale)
{
    _windowWidth = std::max(width, narrowestWindow);
    _scale = std::max(scale, 1.0);
    place();
}

void PageDeck::setZoom(double zoom)
{
    _zoom = zoom;
    place();
}

double PageDeck::pointsPerPagePoint() const
{
    return std::min(_windowWidth - 2 * gap, widestFit) / _widest * _zoom;
}

void PageDeck::place()
{
    const double points = pointsPerPagePoint();
    _tops.resize(_pages.size());
    double y = shownGap();
    for (std::size_t page = 0; page < _pages.size(); ++page) {
        _tops[page] = y;
        y += _pages[page].height * points + shownGap();
    }
    _bottom = y;
}

Size PageDeck::contentSize() const
{
    return {std::max(_windowWidth * _zoom, _widest * pointsPerPagePoint() + 2 * shownGap()), _bottom};
}

Rect PageDeck::pageFrame(std::size_t page) const
{
    const double points = pointsPerPagePoint();
    const double width = _pages[page].width * points;
    return {(contentSize().width - width) / 2, _tops[page], width, _pages[page].height * points};
}

std::optional<std::size_t> PageDeck::pageAt(double y) const
{
    if (_pages.empty())
        return std::nullopt;
    const auto after = std::ranges::upper_bound(_tops, y);
    return after == _tops.begin() ? 0 : static_cast<std::size_t>(after - _tops.begin()) - 1;
}

PageDeck::PageRange PageDeck::pagesIn(const Rect& visible) const
{
    const auto first = pageAt(visible.y), last = pageAt(visible.maxY());
    return first ? PageRange{*first, *last + 1} : PageRange{};
}

std::size_t PageDeck::currentPage(const Rect& visible) const
{
    constexpr double readingPlace = 0.4; ///< share of the window's height
    return pageAt(visible.y + visible.height * readingPlace).value_or(0);
}

Point PageDeck::toPage(std::size_t page, Point content) const
{
    const auto frame = pageFrame(page);
    const double points = pointsPerPagePoint();
    return {(content.x - frame.x) / points, (content.y - frame.y) / points};
}

Rect PageDeck::toContent(std::size_t page, const Rect& onPage) const
{
    const auto frame = pageFrame(page);
    const double points = pointsPerPagePoint();
    return {frame.x + onPage.x * points, frame.y + onPage.y * points, onPage.width * points,
        onPage.height * points};
}

double PageDeck::wantedPixelsPerPoint(std::size_t page) const
{
    const auto& size = _pages[page];
    return std::min({fullPixelsPerPoint(), std::sqrt(maxPagePixels / (size.width * size.height)),
        longestPictureSide / std::max(size.width, size.height)});
}

std::optional<PageDeck::Task> PageDeck::nextTask(const Rect& visible) const
{
    const auto seen = pagesIn(visible);
    const auto missing = [this](std::size_t page) -> std::optional<Task> {
        const auto kept = _kept.find(page);
        const double wanted = wantedPixelsPerPoint(page);
        if (kept != _kept.end() && isNear(kept->second.pixelsPerPoint, wanted))
            return std::nullopt;
        return Task{page, wanted, {0, 0, _pages[page].width, _pages[page].height}, false};
    };
    for (std::size_t page = seen.first; page < seen.end; ++page) {
        if (const auto task = missing(page))
            return task;
    }
    if (const auto task = detailTask(visible))
        return task;
    // The neighbouring pages are drawn as well, so that they show at once when the user turns the page.
    const PageRange near{seen.first > 0 ? seen.first - 1 : 0, std::min(seen.end + 1, _pages.size())};
    for (const auto page : {near.end - 1, near.first}) {
        const auto task = _pages.empty() ? std::nullopt : missing(page);
        if (task && hasRoomFor(*task, near))
            return task;
    }
    return std::nullopt;
}

/// Answers whether a neighbouring page fits into the memory limit, because it would otherwise be dropped and
/// drawn again and again.
bool PageDeck::hasRoomFor(const Task& task, const PageRange& near) const
{
    double bytes = task.part.width * task.part.height * task.pixelsPerPoint * task.pixelsPerPoint * 4;
    for (auto page = near.first; page < near.end; ++page) {
        const auto kept = _kept.find(page);
        if (page != task.page && kept != _kept.end())
            bytes += static_cast<double>(bytesOf(kept->second.picture));
    }
    // The estimate is rough because sides are rounded to whole pixels.
    constexpr double roughly = 0.95;
    return bytes < roughly * static_cast<double>(maxPictureBytes);
}

Rect PageDeck::visiblePart(std::size_t page, const Rect& visible) const
{
    const auto seen = common(pageFrame(page), visible);
    const auto corner = toPage(page, seen.origin());
    const double points = pointsPerPagePoint();
    return {corner.x, corner.y, seen.width / points, seen.height / points};
}

std::optional<PageDeck::Task> PageDeck::detailTask(const Rect& visible) const
{
    if (_pages.empty())
        return std::nullopt;
    const auto page = currentPage(visible);
    const double full = fullPixelsPerPoint();
    if (isNear(wantedPixelsPerPoint(page), full) || isBroken(page))
        return std::nullopt;
    const auto part = visiblePart(page, visible);
    const bool isThere = _detail && _detail->task.page == page && isNear(_detail->task.pixelsPerPoint, full)
        && covers(_detail->task.part, part);
    if (isThere || part.width <= 0 || part.height <= 0
        || part.width * part.height * full * full > 2 * maxPagePixels)
        return std::nullopt;
    return Task{page, full, part, true};
}

void PageDeck::finish(const Task& task, std::optional<Image> picture, const Rect& visible)
{
    if (task.page >= _pages.size())
        return;
    // An old detail is better than none, but only until the page itself has been drawn as finely.
    if (_detail && !task.isDetail && _detail->task.page == task.page && _detail->task.pixelsPerPoint == 0
        && isNear(task.pixelsPerPoint, fullPixelsPerPoint()))
        _detail.reset();
    if (!task.isDetail)
        _kept.insert_or_assign(task.page, Kept{std::move(picture), task.pixelsPerPoint});
    else if (picture)
        _detail = Detail{task, *picture};
    evict(visible);
}

void PageDeck::evict(const Rect& visible)
{
    std::size_t bytes = 0;
    for (const auto& [page, kept] : _kept)
        bytes += bytesOf(kept.picture);
    const auto seen = pagesIn(visible);
    const auto distance = [&](std::size_t page) {
        return page < seen.first ? seen.first - page : page >= seen.end ? page - seen.end + 1 : 0;
    };
    while (bytes > maxPictureBytes && _kept.size() > 1) {
        // The farthest page is at one of the two ends.
        const auto first = _kept.begin(), last = std::prev(_kept.end());
        const auto farthest = distance(first->first) > distance(last->first) ? first : last;
        if (distance(farthest->first) == 0)
            return;
        bytes -= bytesOf(farthest->second.picture);
        _kept.erase(farthest);
    }
}

void PageDeck::forgetPictures()
{
    std::erase_if(_kept, [](const auto& entry) { return !entry.second.picture; });
    for (auto& [page, kept] : _kept)
        kept.pixelsPerPoint = 0;
    if (_detail)
        _detail->task.pixelsPerPoint = 0;
}

const Image* PageDeck::picture(std::size_t page) const
{
    const auto kept = _kept.find(page);
    return kept != _kept.end() && kept->second.picture ? &*kept->second.picture : nullptr;
}

bool PageDeck::isBroken(std::size_t page) const
{
    const auto kept = _kept.find(page);
    return kept != _kept.end() && !kept->second.picture;
}

} // namespace screens
