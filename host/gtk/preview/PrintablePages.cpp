// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PrintablePages.h"

#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/preview/PreviewModule.h"
#include "host/system/texts/Translate.h"
#include "screens/preview/TextDecoding.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <glib/gstdio.h>

#include <algorithm>
#include <cerrno>
#include <vector>

namespace host::gtk {

using host::system::textKey;
using host::system::translated;
using platform::Error;
using platform::Result;

namespace {

using Pages = std::shared_ptr<PrintablePages>;

constexpr int pictureSide = 4000; ///< pixels: A4 at 340 dots to an inch
constexpr gsize longestText = 4U << 20U; ///< bytes, some 1500 pages
constexpr auto textFont = "Monospace 9";

class PicturePage : public PrintablePages {
public:
    explicit PicturePage(ObjectRef<GdkPixbuf> picture)
        : _picture(std::move(picture))
    {
    }
    int paginate(GtkPrintContext*) override { return 1; }
    void draw(GtkPrintContext* paper, int) override
    {
        constexpr double pointsOfPixel = 72.0 / 96;
        fitOnPaper(paper, gdk_pixbuf_get_width(_picture.get()), gdk_pixbuf_get_height(_picture.get()),
            pointsOfPixel * 2);
        auto* cairo = gtk_print_context_get_cairo_context(paper);
        gdk_cairo_set_source_pixbuf(cairo, _picture.get(), 0, 0);
        cairo_paint(cairo);
    }

private:
    ObjectRef<GdkPixbuf> _picture;
};

class TextPages : public PrintablePages {
public:
    explicit TextPages(std::string text)
        : _text(std::move(text))
    {
    }
    int paginate(GtkPrintContext* paper) override
    {
        makeLayout(paper);
        const double height = gtk_print_context_get_height(paper) * PANGO_SCALE;
        _starts = {0};
        double used = 0;
        for (int line = 0; line < pango_layout_get_line_count(_layout.get()); ++line) {
            PangoRectangle extents;
            pango_layout_line_get_extents(
                pango_layout_get_line_readonly(_layout.get(), line), nullptr, &extents);
            if (used + extents.height > height && line > _starts.back()) {
                _starts.push_back(line);
                used = 0;
            }
            used += extents.height;
        }
        return static_cast<int>(_starts.size());
    }
    void draw(GtkPrintContext* paper, int page) override
    {
        auto* cairo = gtk_print_context_get_cairo_context(paper);
        const auto index = static_cast<std::size_t>(page);
        const int end =
            index + 1 < _starts.size() ? _starts[index + 1] : pango_layout_get_line_count(_layout.get());
        double y = 0;
        for (int line = _starts[index]; line < end; ++line) {
            auto* laidOut = pango_layout_get_line_readonly(_layout.get(), line);
            PangoRectangle extents;
            pango_layout_line_get_extents(laidOut, nullptr, &extents);
            cairo_move_to(cairo, 0, (y - extents.y) / PANGO_SCALE);
            pango_cairo_show_layout_line(cairo, laidOut);
            y += extents.height;
        }
    }

private:
    void makeLayout(GtkPrintContext* paper)
    {
        _layout = ObjectRef<PangoLayout>::adopt(gtk_print_context_create_pango_layout(paper));
        const std::unique_ptr<PangoFontDescription, decltype(&pango_font_description_free)> font(
            pango_font_description_from_string(textFont), pango_font_description_free);
        pango_layout_set_font_description(_layout.get(), font.get());
        pango_layout_set_width(
            _layout.get(), static_cast<int>(gtk_print_context_get_width(paper) * PANGO_SCALE));
        pango_layout_set_wrap(_layout.get(), PANGO_WRAP_WORD_CHAR);
        pango_layout_set_text(_layout.get(), _text.data(), static_cast<int>(_text.size()));
    }

    std::string _text;
    ObjectRef<PangoLayout> _layout;
    std::vector<int> _starts; ///< the first line of each page
};

Result<Pages> readPdf(const std::string& path, const PreviewModule& previews)
{
    if (const auto libraries = previews.load())
        return libraries->readPrintablePdf(path);
    return PreviewModule::missingError();
}

Result<Pages> readPicture(const std::string& path)
{
    GError* error = nullptr;
    int width = 0, height = 0;
    gdk_pixbuf_get_file_info(path.c_str(), &width, &height);
    auto* picture = std::max(width, height) > pictureSide
        ? gdk_pixbuf_new_from_file_at_scale(path.c_str(), pictureSide, pictureSide, TRUE, &error)
        : gdk_pixbuf_new_from_file(path.c_str(), &error);
    if (!picture)
        return printingError(textKey("The picture is damaged."), error);
    const auto raw = ObjectRef<GdkPixbuf>::adopt(picture);
    return Pages(std::make_shared<PicturePage>(
        ObjectRef<GdkPixbuf>::adopt(gdk_pixbuf_apply_embedded_orientation(raw.get()))));
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

void fitOnPaper(GtkPrintContext* paper, double width, double height, double largest)
{
    auto* cairo = gtk_print_context_get_cairo_context(paper);
    const double paperWidth = gtk_print_context_get_width(paper);
    const double paperHeight = gtk_print_context_get_height(paper);
    const double scale = std::min({paperWidth / width, paperHeight / height, largest});
    cairo_translate(cairo, (paperWidth - width * scale) / 2, (paperHeight - height * scale) / 2);
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
