// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"
#include "platform/Image.h"
#include "screens/PlatformNames.h"

#include <cstddef>
#include <map>
#include <optional>
#include <vector>

namespace screens {

/// Pages one below the other, and the pictures of them that are kept. The widest page fits the window at a
/// zoom of 1. "Content" points are the interface's, counted from the top left corner of all the pages; "page"
/// points are the document's own. A value that knows no thread.
class PageDeck {
public:
    static constexpr double gap = 12; ///< between pages and around them, content points at a zoom of 1
    static constexpr double widestFit = 900; ///< a page is not made wider than this to fit
    static constexpr double maxPagePixels = 6e6; ///< a picture of a whole page has no more
    /// No side of a picture of a whole page is longer, because graphics hardware takes no longer one.
    static constexpr double longestPictureSide = 16'000;
    static constexpr std::size_t maxPictureBytes = 64 << 20; ///< the limit for all kept pictures together

    void setPages(
        std::vector<Size> pages); ///< pages that keep their size keep their pictures, which count as stale
    /// `scale` is the number of device pixels to a point.
    void setWindow(double width, double scale);
    /// The pages and the gaps grow with the zoom, so that a place in the content stays the same share of its
    /// size.
    void setZoom(double zoom);
    double zoom() const { return _zoom; }

    std::size_t pageCount() const { return _pages.size(); }
    Size contentSize() const;
    Rect pageFrame(std::size_t page) const; ///< content points
    std::optional<std::size_t> pageAt(
        double y) const; ///< answers the page nearest to a height in the content
    struct PageRange {
        std::size_t first = 0, end = 0;
    };
    PageRange pagesIn(const Rect& visible) const;
    /// Answers the page that the user is reading when this part of the content is visible.
    std::size_t currentPage(const Rect& visible) const;
    Point toPage(std::size_t page, Point content) const;
    Rect toContent(std::size_t page, const Rect& onPage) const;

    /// A picture to be drawn, either of a whole page or of the visible part.
    struct Task {
        std::size_t page = 0;
        double pixelsPerPoint = 1;
        Rect part; ///< page points
        bool isDetail = false;
    };
    /// Answers the picture that is most urgent when this part of the content is visible, or nothing when all
    /// are there.
    std::optional<Task> nextTask(const Rect& visible) const;
    /// Keeps the result of a task. Without a picture the page is not asked for again.
    void finish(const Task& task, std::optional<Image> picture, const Rect& visible);
    void forgetPictures(); ///< old pictures stay on the screen until they are drawn again

    /// Answers the picture of a page, which may be too coarse, or null when there is none yet.
    const Image* picture(std::size_t page) const;
    bool isBroken(std::size_t page) const;
    struct Detail {
        Task task;
        Image picture;
    };
    const std::optional<Detail>& detail() const { return _detail; } ///< lies over its page

private:
    struct Kept {
        std::optional<Image> picture; ///< absent: the page cannot be drawn
        double pixelsPerPoint = 0; ///< 0: to be drawn again
    };

    void place();
    double shownGap() const { return gap * _zoom; }
    double pointsPerPagePoint() const;
    double wantedPixelsPerPoint(std::size_t page) const;
    double fullPixelsPerPoint() const { return pointsPerPagePoint() * _scale; }
    std::optional<Task> detailTask(const Rect& visible) const;
    Rect visiblePart(std::size_t page, const Rect& visible) const;
    bool hasRoomFor(const Task& task, const PageRange& near) const;
    void evict(const Rect& visible);

    std::vector<Size> _pages;
    std::vector<double> _tops;
    double _widest = 1, _bottom = 0;
    double _windowWidth = 360, _scale = 1, _zoom = 1;
    std::map<std::size_t, Kept> _kept;
    std::optional<Detail> _detail;
};

} // namespace screens
