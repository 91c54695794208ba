#include "host/previews/PopplerDocuments.h"

#include "host/system/SystemErrors.h"

#include <cairo.h>
#include <poppler.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <mutex>
#include <optional>
#include <utility>

namespace host::previews {

using host::system::systemError;
using platform::Error;
using platform::Image;
using platform::PagedDocument;
using platform::PagesErrorCode;
using platform::PageText;
using platform::Point;
using platform::Rect;
using platform::Result;
using platform::Size;

namespace {

template <typename T>
struct Unref {
    void operator()(T* object) const { g_object_unref(object); }
};
template <typename T>
using Object = std::unique_ptr<T, Unref<T>>;
using Page = Object<PopplerPage>;

struct DestroyCairo {
    void operator()(cairo_t* context) const { cairo_destroy(context); }
    void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};

constexpr Size sheetOfPaper{595, 842};
constexpr double longestSide = 14'400; ///< points; the format's own limit of 200 inches

Error pagesError(PagesErrorCode code)
{
    return {platform::errorDomain::pages, static_cast<int>(code)};
}

PopplerRectangle between(Point from, Point to)
{
    return {from.x, from.y, to.x, to.y};
}

class PopplerPages : public PagedDocument {
public:
    explicit PopplerPages(Object<PopplerDocument> document)
        : _document(std::move(document))
        , _count(static_cast<std::size_t>(poppler_document_get_n_pages(_document.get())))
    {
    }

    std::size_t pageCount() const override { return _count; }

    Size pageSize(std::size_t index) const override
    {
        const std::lock_guard lock(_mutex);
        return sizeOf(page(index).get());
    }

    Result<Image> renderPage(std::size_t index, double pixelsPerPoint, const Rect& part) const override
    {
        const int width = static_cast<int>(std::lround(part.width * pixelsPerPoint));
        const int height = static_cast<int>(std::lround(part.height * pixelsPerPoint));
        if (width <= 0 || height <= 0 || width > maxRenderedPixels / height)
            return pagesError(PagesErrorCode::TooLarge);
        const std::lock_guard lock(_mutex);
        const auto drawn = page(index);
        if (!drawn)
            return pagesError(PagesErrorCode::Damaged);
        std::vector<std::uint32_t> pixels(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
        draw(*drawn, {width, height, pixelsPerPoint, part.origin()}, pixels);
        return Image::fromPixels(width, height, pixelsPerPoint, std::move(pixels));
    }

    std::vector<Rect> find(std::size_t index, const std::string& text) const override
    {
        const std::lock_guard lock(_mutex);
        const auto searched = page(index);
        if (!searched || text.empty())
            return {};
        const double height = sizeOf(searched.get()).height;
        std::vector<Rect> found;
        auto* list = poppler_page_find_text_with_options(searched.get(), text.c_str(), POPPLER_FIND_DEFAULT);
        for (auto* entry = list; entry; entry = entry->next) {
            // The library counts upwards from the bottom here, and downwards from the top in a selection.
            auto* place = static_cast<PopplerRectangle*>(entry->data);
            found.push_back({place->x1, height - place->y2, place->x2 - place->x1, place->y2 - place->y1});
            poppler_rectangle_free(place);
        }
        g_list_free(list);
        return found;
    }

    PageText textBetween(std::size_t index, Point from, Point to) const override
    {
        const std::lock_guard lock(_mutex);
        const auto selected = page(index);
        if (!selected)
            return {};
        auto range = between(from, to);
        PageText found;
        if (char* text = poppler_page_get_selected_text(selected.get(), POPPLER_SELECTION_GLYPH, &range)) {
            found.text = text;
            g_free(text);
        }
        auto* region = poppler_page_get_selected_region(selected.get(), 1, POPPLER_SELECTION_GLYPH, &range);
        for (int i = 0; i < cairo_region_num_rectangles(region); ++i) {
            cairo_rectangle_int_t place;
            cairo_region_get_rectangle(region, i, &place);
            found.places.push_back({static_cast<double>(place.x), static_cast<double>(place.y),
                static_cast<double>(place.width), static_cast<double>(place.height)});
        }
        cairo_region_destroy(region);
        return found;
    }

private:
    struct Sheet {
        int width, height; ///< pixels
        double pixelsPerPoint;
        Point origin; ///< of the part, on the page
    };

    Page page(std::size_t index) const
    {
        return Page(poppler_document_get_page(_document.get(), static_cast<int>(index)));
    }

    static Size sizeOf(PopplerPage* page)
    {
        Size size;
        if (page)
            poppler_page_get_size(page, &size.width, &size.height);
        const auto isSide = [](double side) { return side > 0 && std::isfinite(side); };
        if (!isSide(size.width) || !isSide(size.height))
            return sheetOfPaper;
        return {std::min(size.width, longestSide), std::min(size.height, longestSide)};
    }

    static void draw(PopplerPage& page, const Sheet& sheet, std::vector<std::uint32_t>& pixels)
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

    mutable std::mutex _mutex; // the library's documents know no threads
    Object<PopplerDocument> _document;
    std::size_t _count;
};

std::optional<Error> checkFile(const std::string& path)
{
    struct stat status { };
    if (::stat(path.c_str(), &status) != 0)
        return errno == ENOENT ? Error(platform::FileErrorCode::NoSuchFile) : systemError(errno, path);
    // Anything but a regular file could keep the reader waiting.
    if (!S_ISREG(status.st_mode))
        return pagesError(PagesErrorCode::Damaged);
    if (::access(path.c_str(), R_OK) != 0)
        return systemError(errno, path);
    return std::nullopt;
}

PagesErrorCode codeOf(const GError* problem)
{
    const bool needsPassword =
        problem && g_error_matches(problem, POPPLER_ERROR, POPPLER_ERROR_ENCRYPTED) != FALSE;
    return needsPassword ? PagesErrorCode::PasswordRequired : PagesErrorCode::Damaged;
}

} // namespace

Result<std::shared_ptr<PagedDocument>> PopplerDocuments::open(const std::string& path) const
{
    if (const auto refused = checkFile(path))
        return *refused;
    const Object<GFile> file(g_file_new_for_path(path.c_str()));
    GError* problem = nullptr;
    Object<PopplerDocument> document(poppler_document_new_from_gfile(file.get(), nullptr, nullptr, &problem));
    const auto code = codeOf(problem);
    g_clear_error(&problem);
    if (!document)
        return pagesError(code);
    if (poppler_document_get_n_pages(document.get()) <= 0)
        return pagesError(PagesErrorCode::Damaged);
    return std::shared_ptr<PagedDocument>(std::make_shared<PopplerPages>(std::move(document)));
}

} // namespace host::previews
