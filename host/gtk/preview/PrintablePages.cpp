// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PrintablePages.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/preview/PreviewModule.h"
#include "host/system/texts/Translate.h"
#include "platform/ImageLoader.h"
#include "platform/Services.h"
#include "screens/ErrorWords.h"
#include "screens/preview/TextDecoding.h"

#include <glib/gstdio.h>
#include <pango/pangocairo.h>

#include <algorithm>
#include <cerrno>
#include <compare>
#include <string_view>
#include <vector>

namespace host::gtk {

using host::system::textKey;
using host::system::translated;
using platform::Error;
using platform::Image;
using platform::Result;
using platform::Size;

namespace {

using Pages = std::shared_ptr<PrintablePages>;

constexpr int pictureSide = 4000; ///< pixels: A4 at 340 dots to an inch
constexpr gsize longestText = 4U << 20U; ///< bytes, some 1500 pages
/// A longer paragraph is laid out in parts, because the layout of all of it would take much memory.
constexpr std::size_t longestParagraph = 16U << 10U; // bytes
constexpr auto textFont = "Monospace 9";

class PicturePage : public PrintablePages {
public:
    explicit PicturePage(Image picture)
        : _picture(std::move(picture))
    {
    }
    int paginate(Size) override { return 1; }
    void draw(cairo_t* cairo, Size paper, int) override
    {
        constexpr double pointsOfPixel = 72.0 / 96;
        fitOnPaper(cairo, paper, _picture.size(), pointsOfPixel * 2);
        ImagePaint::draw(cairo, _picture, {0, 0, _picture.size().width, _picture.size().height});
    }

private:
    Image _picture;
};

/// A text whose paragraphs are laid out one by one.
class TextPages : public PrintablePages {
public:
    explicit TextPages(std::string text)
        : _text(std::move(text))
        , _context(ObjectRef<PangoContext>::adopt(makeContext()))
    {
    }
    int paginate(Size paper) override
    {
        _pages = {Page()};
        double used = 0;
        for (std::size_t start = 0; start < _text.size(); start = paragraphAt(start).next) {
            const auto layout = layOut(start, paper);
            for (int line = 0; line < pango_layout_get_line_count(layout.get()); ++line) {
                const double height = extentsOf(layout.get(), line).height;
                if (used + height > paper.height * PANGO_SCALE && used > 0) {
                    _pages.push_back({start, line});
                    used = 0;
                }
                used += height;
            }
        }
        return static_cast<int>(_pages.size());
    }
    void draw(cairo_t* cairo, Size paper, int page) override
    {
        const auto index = static_cast<std::size_t>(page);
        const auto end = index + 1 < _pages.size() ? _pages[index + 1] : Page{_text.size(), 0};
        double y = 0;
        for (auto at = _pages[index]; at.paragraph < _text.size() && at < end;
             at = {paragraphAt(at.paragraph).next, 0}) {
            const auto layout = layOut(at.paragraph, paper);
            const int last =
                at.paragraph == end.paragraph ? end.line : pango_layout_get_line_count(layout.get());
            for (int line = at.line; line < last; ++line) {
                const auto extents = extentsOf(layout.get(), line);
                cairo_move_to(cairo, 0, (y - extents.y) / PANGO_SCALE);
                pango_cairo_show_layout_line(cairo, pango_layout_get_line_readonly(layout.get(), line));
                y += extents.height;
            }
        }
    }

private:
    /// The place where a page begins.
    struct Page {
        std::size_t paragraph = 0; ///< byte of the text
        int line = 0; ///< of that paragraph
        auto operator<=>(const Page&) const = default;
    };
    struct Paragraph {
        std::string_view words;
        std::size_t next; ///< where the next paragraph begins
    };

    /// The threads that print take turns, so the fonts belong to none of them.
    static PangoContext* makeContext()
    {
        constexpr double pointsToAnInch = 72;
        const auto fonts = ObjectRef<PangoFontMap>::adopt(pango_cairo_font_map_new());
        auto* context = pango_font_map_create_context(fonts.get());
        pango_cairo_context_set_resolution(context, pointsToAnInch);
        return context;
    }
    static PangoRectangle extentsOf(PangoLayout* layout, int line)
    {
        PangoRectangle extents;
        pango_layout_line_get_extents(pango_layout_get_line_readonly(layout, line), nullptr, &extents);
        return extents;
    }
    Paragraph paragraphAt(std::size_t start) const
    {
        const auto rest = std::string_view(_text).substr(start, longestParagraph);
        const auto lineEnd = rest.find_first_of("\r\n");
        if (lineEnd == std::string_view::npos) {
            const auto words = start + rest.size() < _text.size() ? screens::withoutCutCharacter(rest) : rest;
            return {words, start + words.size()};
        }
        const bool isPair = std::string_view(_text).substr(start + lineEnd, 2) == "\r\n";
        return {rest.substr(0, lineEnd), start + lineEnd + (isPair ? 2 : 1)};
    }
    ObjectRef<PangoLayout> layOut(std::size_t start, Size paper) const
    {
        const auto words = paragraphAt(start).words;
        auto layout = ObjectRef<PangoLayout>::adopt(pango_layout_new(_context.get()));
        const std::unique_ptr<PangoFontDescription, decltype(&pango_font_description_free)> font(
            pango_font_description_from_string(textFont), pango_font_description_free);
        pango_layout_set_font_description(layout.get(), font.get());
        pango_layout_set_width(layout.get(), static_cast<int>(paper.width * PANGO_SCALE));
        pango_layout_set_wrap(layout.get(), PANGO_WRAP_WORD_CHAR);
        pango_layout_set_text(layout.get(), words.data(), static_cast<int>(words.size()));
        return layout;
    }

    std::string _text;
    ObjectRef<PangoContext> _context;
    std::vector<Page> _pages;
};

Result<Pages> readPdf(const std::string& path, const PreviewModule& previews)
{
    if (const auto libraries = previews.load())
        return libraries->readPrintablePdf(path);
    return PreviewModule::missingError();
}

Result<Pages> readPicture(const std::string& path)
{
    const auto picture =
        platform::services().imageLoader().load(path, {.maxWidth = pictureSide, .maxHeight = pictureSide});
    if (!picture)
        return Error(picture.error->domain(), picture.error->code(),
            {{std::string(platform::errorKey::localizedDescription), screens::errorWords(*picture.error)}});
    return Pages(std::make_shared<PicturePage>(*picture.value));
}

Result<Pages> readText(const std::string& path, const PreviewModule& previews)
{
    GError* error = nullptr;
    GStatBuf status;
    if (g_stat(path.c_str(), &status) == 0 && static_cast<gsize>(status.st_size) > longestText)
        return printingError(textKey("The text is too long to be printed from here."), nullptr);
    char* bytes = nullptr;
    gsize length = 0;
    if (!g_file_get_contents(path.c_str(), &bytes, &length, &error))
        return printingError(textKey("The document could not be read."), error);
    const std::unique_ptr<char, decltype(&g_free)> owned(bytes, g_free);
    using screens::decodedText;
    return Pages(
        std::make_shared<TextPages>(decodedText({bytes, length}, platform::TextEnd::Whole, previews)));
}

} // namespace

void fitOnPaper(cairo_t* cairo, Size paper, Size content, double largest)
{
    const double scale = std::min({paper.width / content.width, paper.height / content.height, largest});
    cairo_translate(
        cairo, (paper.width - content.width * scale) / 2, (paper.height - content.height * scale) / 2);
    cairo_scale(cairo, scale, scale);
}

Error printingError(const char* words, GError* error)
{
    const std::unique_ptr<GError, decltype(&g_error_free)> owned(error, g_error_free);
    platform::PropertyDictionary info{
        {std::string(platform::errorKey::localizedDescription), translated(words)}};
    if (error)
        info.emplace(std::string(platform::errorKey::localizedFailureReason), std::string(error->message));
    return {platform::errorDomain::system, error ? error->code : EFBIG, std::move(info)};
}

Result<Pages> readPrintablePages(const std::string& path, PrintableKind kind, const PreviewModule& previews)
{
    switch (kind) {
    case PrintableKind::Pdf:
        return readPdf(path, previews);
    case PrintableKind::Picture:
        return readPicture(path);
    case PrintableKind::Text:
        break;
    }
    return readText(path, previews);
}

} // namespace host::gtk
