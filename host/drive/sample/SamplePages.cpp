// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SamplePages.h"

#include "host/drive/sample/CairoPage.h"

#include <cairo-pdf.h>

namespace host::drive::sample {

namespace {

constexpr double pageWidth = 595, pageHeight = 842; // A4 in points
constexpr double margin = 64;
constexpr Ink darkInk{.16, .15, .19}, mutedInk{.45, .44, .48}, accentInk{.21, .52, .89};

cairo_status_t appendBytes(void* closure, const unsigned char* data, unsigned length)
{
    static_cast<std::string*>(closure)->append(reinterpret_cast<const char*>(data), length);
    return CAIRO_STATUS_SUCCESS;
}

/// A PDF under construction.
class Paper {
public:
    explicit Paper(const std::string& title)
        : _surface(cairo_pdf_surface_create_for_stream(&appendBytes, &_bytes, pageWidth, pageHeight))
        , _context(cairo_create(_surface.get()))
    {
        cairo_pdf_surface_set_metadata(_surface.get(), CAIRO_PDF_METADATA_TITLE, title.c_str());
    }

    cairo_t* context() const { return _context.get(); }

    void text(const std::string& text, double x, double y, double size, Ink ink,
        cairo_font_weight_t weight = CAIRO_FONT_WEIGHT_NORMAL) const
    {
        cairo_select_font_face(_context.get(), "Cantarell", CAIRO_FONT_SLANT_NORMAL, weight);
        cairo_set_font_size(_context.get(), size);
        setInk(_context.get(), ink);
        cairo_move_to(_context.get(), x, y);
        cairo_show_text(_context.get(), text.c_str());
    }

    std::string finish()
    {
        _context.reset();
        cairo_surface_finish(_surface.get());
        return std::move(_bytes);
    }

private:
    std::string _bytes;
    Surface _surface;
    Context _context;
};

void drawLine(const Paper& paper, const std::string& line, double y)
{
    if (line.starts_with("- ")) {
        setInk(paper.context(), accentInk);
        cairo_arc(paper.context(), margin + 5, y - 4, 2.5, 0, 6.2832);
        cairo_fill(paper.context());
        paper.text(line.substr(2), margin + 18, y, 12, darkInk);
        return;
    }
    double x = margin;
    for (std::size_t begin = 0; begin <= line.size();) {
        const auto bar = std::min(line.find('|', begin), line.size());
        paper.text(line.substr(begin, bar - begin), x, y, 12, darkInk);
        x += 120;
        begin = bar + 1;
    }
}

void drawPage(const Paper& paper, const std::string& title, const Page& page, std::size_t number)
{
    setInk(paper.context(), accentInk);
    cairo_rectangle(paper.context(), 0, 0, pageWidth, 10);
    cairo_fill(paper.context());
    paper.text(title, margin, 52, 10, mutedInk);
    paper.text(page.heading, margin, 104, 24, darkInk, CAIRO_FONT_WEIGHT_BOLD);
    double y = 146;
    for (const auto& line : page.lines) {
        drawLine(paper, line, y);
        y += 22;
    }
    paper.text(std::to_string(number), pageWidth / 2, pageHeight - 36, 10, mutedInk);
}

} // namespace

std::string pagesPdf(const std::string& title, const std::vector<Page>& pages)
{
    Paper paper(title);
    std::size_t number = 0;
    for (const auto& page : pages) {
        drawPage(paper, title, page, ++number);
        cairo_show_page(paper.context());
    }
    return paper.finish();
}

std::string ticketPdf(const std::string& title, const std::vector<std::string>& lines, unsigned seed)
{
    Paper paper(title);
    drawPage(paper, "Ticket", {title, lines}, 1);
    constexpr int squares = 21;
    constexpr double side = 8;
    setInk(paper.context(), darkInk);
    for (int y = 0; y < squares; ++y) {
        for (int x = 0; x < squares; ++x) {
            seed = seed * 1'664'525u + 1'013'904'223u;
            if (seed >> 31)
                cairo_rectangle(
                    paper.context(), pageWidth - margin - (squares - x) * side, 420 + y * side, side, side);
        }
    }
    cairo_fill(paper.context());
    cairo_show_page(paper.context());
    return paper.finish();
}

} // namespace host::drive::sample
