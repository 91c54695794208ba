// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/preview/PrintRun.h"
#include "host/system/desktop/GdkPixbufImageLoader.h"
#include "host/system/queues/GLibDispatch.h"
#include "platform/Services.h"
#include "tests/support/PlainTexts.h"
#include "tests/support/TemporaryDirectory.h"

#include <gdk-pixbuf/gdk-pixbuf.h>
#include <gtest/gtest.h>
#include <poppler.h>

#include <set>
#include <thread>

namespace {

using host::gtk::ObjectRef;
using host::gtk::PrintableKind;

class Printing : public ::testing::Test {
protected:
    Printing()
    {
        platform::ServiceSet set;
        set.localization = std::make_shared<testing_support::PlainTexts>();
        set.dispatch = std::make_shared<host::system::GLibDispatch>();
        set.imageLoader = std::make_shared<host::system::GdkPixbufImageLoader>();
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
        print(*pages, name);
        const auto document = openPrinted(name);
        return document ? poppler_document_get_n_pages(document.get()) : 0;
    }
    void print(std::shared_ptr<host::gtk::PrintablePages> pages, const std::string& name) const
    {
        int ended = 0;
        host::gtk::startPrinting(
            std::move(pages), name, {.file = folder.at(name + ".out.pdf")}, [&ended](const auto& error) {
                EXPECT_FALSE(error);
                ++ended;
            });
        while (ended == 0)
            g_main_context_iteration(nullptr, TRUE);
        EXPECT_EQ(ended, 1);
    }
    ObjectRef<PopplerDocument> openPrinted(const std::string& name) const
    {
        const auto path = folder.at(name + ".out.pdf");
        const auto file = ObjectRef<GFile>::adopt(g_file_new_for_path(path.c_str()));
        return ObjectRef<PopplerDocument>::adopt(
            poppler_document_new_from_gfile(file.get(), nullptr, nullptr, nullptr));
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

/// Takes long, and remembers who asks.
class SlowPages : public host::gtk::PrintablePages {
public:
    int paginate(platform::Size) override
    {
        work();
        return 2;
    }
    void draw(cairo_t*, platform::Size, int) override { work(); }
    std::multiset<std::thread::id> threads;

private:
    void work()
    {
        threads.insert(std::this_thread::get_id());
        std::this_thread::sleep_for(std::chrono::milliseconds(30));
    }
};

TEST_F(Printing, LaysOutAndDrawsOffTheMainThread)
{
    const auto pages = std::make_shared<SlowPages>();
    print(pages, "slow");
    EXPECT_EQ(pages->threads.size(), 3U);
    EXPECT_EQ(pages->threads.count(std::this_thread::get_id()), 0U);
}

TEST_F(Printing, LeavesNothingOutOfAVeryLongParagraph)
{
    std::string line = "first";
    while (line.size() < 40'000)
        line += " wörter";
    folder.write("line.txt", line + " last\r\n\r\n");
    const int pages = printed("line.txt", PrintableKind::Text);
    ASSERT_GT(pages, 2);
    std::string words;
    const auto document = openPrinted("line.txt");
    for (int page = 0; page < pages; ++page) {
        const auto content = ObjectRef<PopplerPage>::adopt(poppler_document_get_page(document.get(), page));
        const std::unique_ptr<char, decltype(&g_free)> text(poppler_page_get_text(content.get()), g_free);
        words += text.get();
    }
    std::erase_if(words, [](char c) { return c == ' ' || c == '\n'; });
    std::erase(line, ' ');
    EXPECT_EQ(words, line + "last");
}

TEST_F(Printing, SaysWhyADamagedDocumentIsNotPrinted)
{
    folder.write("bad.png", "no picture");
    folder.write("bad.pdf", "%PDF-1.4 no document");
    EXPECT_EQ(printed("bad.png", PrintableKind::Picture), -1);
    EXPECT_EQ(printed("bad.pdf", PrintableKind::Pdf), -1);
    EXPECT_EQ(printed("missing.txt", PrintableKind::Text), -1);
    const auto large = host::gtk::readPrintablePages(folder.write("large.ppm", "P6 30000 30000 255\n"),
        PrintableKind::Picture, *testing_support::linkedPreviews());
    EXPECT_EQ(large.error->text(platform::errorKey::localizedDescription),
        "The picture is too large to be shown here.");
}

} // namespace
