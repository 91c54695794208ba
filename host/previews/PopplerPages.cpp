// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/PopplerPages.h"

#include <cairo.h>

#include <algorithm>
#include <cmath>

namespace host::previews {

using platform::Error;
using platform::Image;
using platform::PageMark;
using platform::PagesErrorCode;
using platform::PageText;
using platform::Point;
using platform::Rect;
using platform::Result;
using platform::Size;

namespace {

struct DestroyCairo {
    void operator()(cairo_t* context) const { cairo_destroy(context); }
    void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};

constexpr Size sheetOfPaper{595, 842};
constexpr double longestSide = 14'400; ///< points; the format's own limit of 200 inches

PopplerRectangle between(Point from, Point to)
{
    return {from.x, from.y, to.x, to.y};
}

struct Sheet {
    int width, height; ///< pixels
    double pixelsPerPoint;
    Point origin; ///< the part's origin on the page
};

void draw(PopplerPage& page, const Sheet& sheet, std::vector<std::uint32_t>& pixels)
{
    const std::unique_ptr<cairo_surface_t, DestroyCairo> surface(
        cairo_image_surface_create_for_data(reinterpret_cast<unsigned char*>(pixels.data()),
            CAIRO_FORMAT_ARGB32, sheet.width, sheet.height, sheet.width * 4));
    {
        const std::unique_ptr<cairo_t, DestroyCairo> context(cairo_create(surface.get()));
        cairo_set_source_rgb(context.get(), 1, 1, 1);
        cairo_paint(context.get());
        cairo_scale(context.get(), sheet.pixelsPerPoint, sheet.pixelsPerPoint);
        cairo_translate(context.get(), -sheet.origin.x, -sheet.origin.y);
        poppler_page_render(&page, context.get());
    }
    cairo_surface_finish(surface.get());
}

PageMark::Kind kindOf(PopplerAnnotType type)
{
    switch (type) {
    case POPPLER_ANNOT_HIGHLIGHT:
        return PageMark::Kind::Highlight;
    case POPPLER_ANNOT_UNDERLINE:
        return PageMark::Kind::Underline;
    case POPPLER_ANNOT_TEXT:
        return PageMark::Kind::Note;
    default:
        return PageMark::Kind::Other;
    }
}

/// Answers whether an annotation of this type adds content for the reader, rather than being a part of the
/// page's mechanism.
bool isAdded(PopplerAnnotType type)
{
    switch (type) {
    case POPPLER_ANNOT_TEXT:
    case POPPLER_ANNOT_FREE_TEXT:
    case POPPLER_ANNOT_LINE:
    case POPPLER_ANNOT_SQUARE:
    case POPPLER_ANNOT_CIRCLE:
    case POPPLER_ANNOT_POLYGON:
    case POPPLER_ANNOT_POLY_LINE:
    case POPPLER_ANNOT_HIGHLIGHT:
    case POPPLER_ANNOT_UNDERLINE:
    case POPPLER_ANNOT_SQUIGGLY:
    case POPPLER_ANNOT_STRIKE_OUT:
    case POPPLER_ANNOT_STAMP:
    case POPPLER_ANNOT_CARET:
    case POPPLER_ANNOT_INK:
        return true;
    default:
        return false;
    }
}

PopplerPages::FoundMark foundMark(PopplerAnnot* annotation, const Rect& place)
{
    const auto type = poppler_annot_get_annot_type(annotation);
    const auto flags = static_cast<unsigned>(poppler_annot_get_flags(annotation));
    constexpr unsigned unseen = POPPLER_ANNOT_FLAG_HIDDEN | POPPLER_ANNOT_FLAG_NO_VIEW;
    constexpr unsigned locked =
        POPPLER_ANNOT_FLAG_READ_ONLY | POPPLER_ANNOT_FLAG_LOCKED | POPPLER_ANNOT_FLAG_LOCKED_CONTENTS;
    PopplerPages::FoundMark found;
    found.mark.kind = kindOf(type);
    found.mark.place = place;
    found.mark.text = takenText(poppler_annot_get_contents(annotation));
    found.mark.isLocked = (flags & locked) != 0;
    found.handle.reset(static_cast<PopplerAnnot*>(g_object_ref(annotation)));
    found.isSeen = isAdded(type) && (flags & unseen) == 0;
    return found;
}

} // namespace

std::string takenText(char* text)
{
    std::string copy = text ? text : "";
    g_free(text);
    return copy;
}

Error pagesError(PagesErrorCode code)
{
    return {platform::errorDomain::pages, static_cast<int>(code)};
}

Result<Object<PopplerDocument>> PopplerPages::checked(Object<PopplerDocument> document, GError* problem)
{
    const bool needsPassword =
        problem && g_error_matches(problem, POPPLER_ERROR, POPPLER_ERROR_ENCRYPTED) != FALSE;
    g_clear_error(&problem);
    if (!document)
        return pagesError(needsPassword ? PagesErrorCode::PasswordRequired : PagesErrorCode::Damaged);
    if (poppler_document_get_n_pages(document.get()) <= 0)
        return pagesError(PagesErrorCode::Damaged);
    return document;
}

PopplerPages::PopplerPages(Object<PopplerDocument> document)
    : _document(std::move(document))
    , _count(static_cast<std::size_t>(poppler_document_get_n_pages(_document.get())))
{
}

void PopplerPages::setDocument(Object<PopplerDocument> document)
{
    const std::lock_guard lock(_mutex);
    _document = std::move(document);
}

PopplerPages::Page PopplerPages::page(PopplerDocument& document, std::size_t index)
{
    return Page(poppler_document_get_page(&document, static_cast<int>(index)));
}

Size PopplerPages::sizeOf(PopplerPage* page)
{
    Size size;
    if (page)
        poppler_page_get_size(page, &size.width, &size.height);
    const auto isSide = [](double side) { return side > 0 && std::isfinite(side); };
    if (!isSide(size.width) || !isSide(size.height))
        return sheetOfPaper;
    return {std::min(size.width, longestSide), std::min(size.height, longestSide)};
}

Rect PopplerPages::fromBottom(const PopplerRectangle& place, double pageHeight)
{
    return {place.x1, pageHeight - place.y2, place.x2 - place.x1, place.y2 - place.y1};
}

PopplerRectangle PopplerPages::toBottom(const Rect& place, double pageHeight)
{
    return {place.x, pageHeight - place.maxY(), place.maxX(), pageHeight - place.y};
}

Size PopplerPages::pageSize(std::size_t index) const
{
    return withDocument([&](PopplerDocument& document) { return sizeOf(page(document, index).get()); });
}

Result<Image> PopplerPages::renderPage(std::size_t index, double pixelsPerPoint, const Rect& part) const
{
    const int width = static_cast<int>(std::lround(part.width * pixelsPerPoint));
    const int height = static_cast<int>(std::lround(part.height * pixelsPerPoint));
    if (width <= 0 || height <= 0 || width > maxRenderedPixels / height
        || std::max(width, height) > longestRenderedSide)
        return pagesError(PagesErrorCode::TooLarge);
    return withDocument([&](PopplerDocument& document) -> Result<Image> {
        const auto drawn = page(document, index);
        if (!drawn)
            return pagesError(PagesErrorCode::Damaged);
        std::vector<std::uint32_t> pixels(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
        draw(*drawn, {width, height, pixelsPerPoint, part.origin()}, pixels);
        // NOLINTNEXTLINE(readability-suspicious-call-argument): pixels per point are the scale
        return Image::fromPixels(width, height, pixelsPerPoint, std::move(pixels));
    });
}

std::vector<Rect> PopplerPages::find(std::size_t index, const std::string& text) const
{
    return withDocument([&](PopplerDocument& document) {
        const auto searched = page(document, index);
        std::vector<Rect> found;
        if (!searched || text.empty())
            return found;
        const double height = sizeOf(searched.get()).height;
        auto* list = poppler_page_find_text_with_options(searched.get(), text.c_str(), POPPLER_FIND_DEFAULT);
        for (auto* entry = list; entry; entry = entry->next) {
            auto* place = static_cast<PopplerRectangle*>(entry->data);
            found.push_back(fromBottom(*place, height));
            poppler_rectangle_free(place);
        }
        g_list_free(list);
        return found;
    });
}

PageText PopplerPages::textBetween(std::size_t index, Point from, Point to) const
{
    return withDocument([&](PopplerDocument& document) {
        const auto selected = page(document, index);
        PageText found;
        if (!selected)
            return found;
        auto range = between(from, to);
        found.text =
            takenText(poppler_page_get_selected_text(selected.get(), POPPLER_SELECTION_GLYPH, &range));
        // Unlike other rectangles of the library, those of a selection count downwards from the top.
        auto* region = poppler_page_get_selected_region(selected.get(), 1, POPPLER_SELECTION_GLYPH, &range);
        for (int i = 0; i < cairo_region_num_rectangles(region); ++i) {
            cairo_rectangle_int_t place;
            cairo_region_get_rectangle(region, i, &place);
            found.places.push_back({static_cast<double>(place.x), static_cast<double>(place.y),
                static_cast<double>(place.width), static_cast<double>(place.height)});
        }
        cairo_region_destroy(region);
        return found;
    });
}

std::vector<PopplerPages::FoundMark> PopplerPages::foundMarks(PopplerPage* page)
{
    std::vector<FoundMark> marks;
    const double height = sizeOf(page).height;
    auto* list = page ? poppler_page_get_annot_mapping(page) : nullptr;
    for (auto* entry = list; entry; entry = entry->next) {
        const auto* mapping = static_cast<PopplerAnnotMapping*>(entry->data);
        // A popup is the window of another annotation and comes and goes with it.
        if (poppler_annot_get_annot_type(mapping->annot) == POPPLER_ANNOT_POPUP)
            continue;
        marks.push_back(foundMark(mapping->annot, fromBottom(mapping->area, height)));
        marks.back().mark.id = static_cast<std::uint32_t>(marks.size() - 1);
    }
    if (list)
        poppler_page_free_annot_mapping(list);
    return marks;
}

std::vector<PageMark> PopplerPages::marks(std::size_t index) const
{
    return withDocument([&](PopplerDocument& document) {
        std::vector<PageMark> seen;
        for (const auto& found : foundMarks(page(document, index).get())) {
            if (found.isSeen)
                seen.push_back(found.mark);
        }
        return seen;
    });
}

platform::PagesRights PopplerPages::rights() const
{
    return withDocument([](PopplerDocument& document) {
        const auto allowed = static_cast<unsigned>(poppler_document_get_permissions(&document));
        platform::PagesRights rights;
        rights.canMark = (allowed & POPPLER_PERMISSIONS_OK_TO_ADD_NOTES) != 0;
        rights.canFillForms = rights.canMark || (allowed & POPPLER_PERMISSIONS_OK_TO_FILL_FORM) != 0;
        return rights;
    });
}

} // namespace host::previews
