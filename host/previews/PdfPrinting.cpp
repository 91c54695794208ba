// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/PdfPrinting.h"

#include "host/gtk/base/ObjectRef.h"
#include "host/previews/PopplerPages.h"
#include "host/system/texts/Translate.h"

#include <poppler.h>

#include <algorithm>
#include <utility>

namespace host::previews {

using gtk::ObjectRef;
using gtk::PrintablePages;
using platform::Result;

namespace {

class PdfPages : public PrintablePages {
public:
    explicit PdfPages(ObjectRef<PopplerDocument> document)
        : _document(std::move(document))
    {
    }
    int paginate(platform::Size) override
    {
        return std::max(1, poppler_document_get_n_pages(_document.get()));
    }
    void draw(cairo_t* cairo, platform::Size paper, int page) override
    {
        const auto content = ObjectRef<PopplerPage>::adopt(poppler_document_get_page(_document.get(), page));
        if (!content)
            return;
        gtk::fitOnPaper(cairo, paper, PopplerPages::sizeOf(content.get()), 1);
        poppler_page_render_for_printing(content.get(), cairo);
    }

private:
    ObjectRef<PopplerDocument> _document;
};

} // namespace

Result<std::shared_ptr<PrintablePages>> readPrintablePdf(const std::string& path)
{
    GError* error = nullptr;
    const auto file = ObjectRef<GFile>::adopt(g_file_new_for_path(path.c_str()));
    auto* document = poppler_document_new_from_gfile(file.get(), nullptr, nullptr, &error);
    if (!document)
        return gtk::printingError(
            system::textKey("The document is damaged or protected by a password."), error);
    return std::shared_ptr<PrintablePages>(
        std::make_shared<PdfPages>(ObjectRef<PopplerDocument>::adopt(document)));
}

} // namespace host::previews
