// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/preview/PrintRun.h"
#include "platform/Services.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/TemporaryDirectory.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <gtest/gtest.h>
#include <poppler.h>

namespace {

using host::gtk::ObjectRef;
using host::gtk::PrintableKind;

class Printing : public ::testing::Test {
protected:
    Printing()
    {
        platform::ServiceSet set;
        set.localization = std::make_shared<testing_support::PlainTexts>();
        platform::installServices(std::move(set));
    }
    ~Printing() override { platform::installServices({}); }

    /// Answers the number of pages when a document is printed into a file, or -1 when it cannot be printed.
    int printed(const std::string& name, PrintableKind kind) const
    {
        const auto pages =
            host::gtk::readPrintablePages(folder.at(name), kind, *testing_support::linkedPreviews());
        if (!pages)
            return pages.error->text(platform::errorKey::localizedDescription)->empty() ? -2 : -1;
        const auto out = folder.at(name + ".out.pdf");
        int ended = 0;
        host::gtk::startPrinting(*pages, name, {.file = out}, [&ended](const auto& error) {
            EXPECT_FALSE(error);
            ++ended;
        });
        while (ended == 0)
            g_main_context_iteration(nullptr, TRUE);
        EXPECT_EQ(ended, 1);
        return pageCount(out);
    }
    static int pageCount(const std::string& path)
    {
        const auto file = ObjectRef<GFile>::adopt(g_file_new_for_path(path.c_str()));
        const auto document = ObjectRef<PopplerDocument>::adopt(
            poppler_document_new_from_gfile(file.get(), nullptr, nullptr, nullptr));
        return document ? poppler_document_get_n_pages(document.get()) : 0;
    }

    testing_support::TemporaryDirectory folder;
};

TEST_F(Printing, PutsTextsPicturesAndDocumentsOnPages)
{
    std::string lines;
    for (int i = 0; i < 400; ++i)
        lines += "line " + std::to_string(i) + "\n";
    folder.write("long.txt", lines);
    folder.write("odd.txt", "caf\xe9");
    folder.write("empty.txt", "");
    const auto picture = ObjectRef<GdkPixbuf>::adopt(gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, 8, 300, 200));
    gdk_pixbuf_fill(picture.get(), 0x336699ff);
    ASSERT_TRUE(gdk_pixbuf_save(picture.get(), folder.at("blue.png").c_str(), "png", nullptr, nullptr));

    const int pages = printed("long.txt", PrintableKind::Text);
    EXPECT_GT(pages, 2);
    EXPECT_EQ(printed("odd.txt", PrintableKind::Text), 1);
    EXPECT_EQ(printed("empty.txt", PrintableKind::Text), 1);
    EXPECT_EQ(printed("blue.png", PrintableKind::Picture), 1);
    EXPECT_EQ(printed("long.txt.out.pdf", PrintableKind::Pdf), pages);
}

TEST_F(Printing, SaysWhyADamagedDocumentIsNotPrinted)
{
    folder.write("bad.png", "no picture");
    folder.write("bad.pdf", "%PDF-1.4 no document");
    EXPECT_EQ(printed("bad.png", PrintableKind::Picture), -1);
    EXPECT_EQ(printed("bad.pdf", PrintableKind::Pdf), -1);
    EXPECT_EQ(printed("missing.txt", PrintableKind::Text), -1);
}

} // namespace
