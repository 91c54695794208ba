// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "GtkEnvironment.h"
#include "WindowFixture.h"
#include "host/previews/PopplerDocuments.h"
#include "host/system/queues/GLibDispatch.h"
#include "host/system/texts/IcuFormatters.h"
#include "screens/preview/PreviewMediaView.h"
#include "screens/preview/PreviewPagesView.h"
#include "screens/preview/PreviewPictureView.h"
#include "screens/preview/PreviewTextView.h"
#include "tests/support/SimplePdf.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <adwaita.h>

namespace {
using namespace screens;
using platform::Image;
using platform::Picture;
using testing_support::makeScreen;

class PreviewViewTests : public testing_support::WindowFixture {
protected:
    PreviewViewTests()
    {
        installed.dispatch = dispatch;
        installed.formatters = std::make_shared<host::system::IcuFormatters>("en_US");
        installed.pagedDocumentOpener = std::make_shared<host::previews::PopplerDocuments>();
        platform::installServices(installed);
    }

    /// Shows a view as large as the window.
    void showPreview(const std::shared_ptr<PreviewView>& view)
    {
        screen->setView(view);
        show(screen);
    }
    GtkScrolledWindow* scroller(const PreviewView& view) const
    {
        return GTK_SCROLLED_WINDOW(adw_bin_get_child(ADW_BIN(nativeOf(view))));
    }
    GtkAdjustment* across(const PreviewView& view) const
    {
        return gtk_scrolled_window_get_hadjustment(scroller(view));
    }
    GtkAdjustment* down(const PreviewView& view) const
    {
        return gtk_scrolled_window_get_vadjustment(scroller(view));
    }
    std::shared_ptr<platform::PagedDocument> document(int pages, const std::string& name)
    {
        std::vector<std::string> texts;
        for (int page = 0; page < pages; ++page)
            texts.push_back("page " + std::to_string(page));
        const auto path = folder.write(name, testing_support::simplePdf(texts));
        return *platform::services().pagedDocumentOpener().open(path).value;
    }

    std::shared_ptr<platform::Dispatch> dispatch = std::make_shared<host::system::GLibDispatch>();
    std::shared_ptr<kit::ViewController> screen = makeScreen("Preview");
    testing_support::TemporaryDirectory folder;
};

Picture picture(int width, int height, int sourceWidth)
{
    std::vector<std::uint32_t> pixels(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    return {{{Image::fromPixels(width, height, 1, std::move(pixels)), 0}}, sourceWidth,
        height * sourceWidth / width};
}

TEST_F(PreviewViewTests, APictureFitsAndIsZoomedAroundItsMiddle)
{
    const auto view = std::make_shared<PreviewPictureView>();
    view->setPicture(picture(1500, 3000, 1500));
    int asked = 0;
    view->setOnNeedsPixels([&] { ++asked; });
    showPreview(view);
    const double width = view->bounds().width, height = view->bounds().height;
    EXPECT_EQ(gtk_adjustment_get_upper(across(*view)), width);
    EXPECT_EQ(gtk_adjustment_get_upper(down(*view)), height);

    view->setZoom(4);
    settle();
    EXPECT_EQ(gtk_adjustment_get_upper(down(*view)), 4 * height);
    EXPECT_NEAR(gtk_adjustment_get_value(down(*view)), 1.5 * height, 1);
    const double shownWidth = 4 * height / 2;
    EXPECT_NEAR(
        gtk_adjustment_get_value(across(*view)), (shownWidth - width) / 2, 4); // margins are whole points

    // A finer picture of the same document changes neither the place nor the zoom.
    view->setPicture(picture(3000, 6000, 3000));
    settle();
    EXPECT_NEAR(gtk_adjustment_get_value(down(*view)), 1.5 * height, 1);
    EXPECT_EQ(view->zoom(), 4);
    // The picture has all the pixels of its file.
    EXPECT_EQ(asked, 0);
    view->setPicture(picture(300, 600, 3000));
    view->setZoom(6);
    EXPECT_EQ(asked, 1);

    view->setZoom(0);
    settle();
    EXPECT_EQ(gtk_adjustment_get_upper(down(*view)), height);
}

TEST_F(PreviewViewTests, PagesKeepTheirPlaceThroughZoomAndChanges)
{
    const auto view = std::make_shared<PreviewPagesView>();
    view->setDocument(document(30, "First.pdf"), {200, 300});
    showPreview(view);
    waitFor([&] { return view->deck().picture(0) != nullptr; }, "the first page");
    EXPECT_EQ(gtk_adjustment_get_upper(down(*view)), view->deck().contentSize().height);

    gtk_adjustment_set_value(down(*view), view->deck().pageFrame(20).y);
    EXPECT_EQ(view->currentPage(), 20U);
    waitFor([&] { return view->deck().picture(20) != nullptr; }, "a page further down");
    settle();
    view->setZoom(3);
    settle();
    EXPECT_EQ(view->currentPage(), 20U);
    const double place = gtk_adjustment_get_value(down(*view));
    EXPECT_GT(gtk_adjustment_get_value(across(*view)), 0);

    view->setDocument(document(40, "Second.pdf"), {200, 300});
    waitFor([&] { return view->deck().picture(20) != nullptr; }, "the page again");
    settle();
    EXPECT_EQ(gtk_adjustment_get_value(down(*view)), place);
    EXPECT_EQ(view->pageCount(), 40U);

    view->goToPage(39);
    settle();
    EXPECT_EQ(view->currentPage(), 39U);
    // The new document ends before the place that was shown.
    view->setDocument(document(2, "Third.pdf"), {200, 300});
    settle();
    EXPECT_EQ(view->currentPage(), 1U);
}

TEST_F(PreviewViewTests, ALongTextComesInPiecesAndKeepsItsPlace)
{
    std::string text;
    for (int line = 0; line < 5'000; ++line)
        text += "line " + std::to_string(line) + " ä\n";
    const auto view = std::make_shared<PreviewTextView>();
    view->setText({text, "Notes.txt", false});
    showPreview(view);
    auto* widget = GTK_TEXT_VIEW(gtk_scrolled_window_get_child(scroller(*view)));
    auto* buffer = gtk_text_view_get_buffer(widget);
    const auto length = [&] { return gtk_text_buffer_get_char_count(buffer); };
    const auto wanted = [](const std::string& all) {
        return static_cast<int>(g_utf8_strlen(all.c_str(), -1));
    };
    waitFor([&] { return length() == wanted(text); }, "the whole text");

    view->setQuery("LINE 4999");
    waitFor(
        [&] { return view->searchState().matches == 1 && view->searchState().current == 1; }, "the match");
    settle();
    waitFor([&] { return gtk_adjustment_get_value(down(*view)) > 3'000; }, "the way to the match");

    // The text grows at its end and changes in the middle while it is shown.
    GtkTextIter start, end;
    gtk_text_buffer_get_selection_bounds(buffer, &start, &end);
    const auto line = gtk_text_iter_get_line(&start);
    auto changed = text + "one more ü\n";
    view->setText({changed, "Notes.txt", false});
    changed.replace(changed.find("line 2500"), 9, "changed ö");
    view->setText({changed, "Notes.txt", false});
    waitFor([&] { return length() == wanted(changed); }, "the changed text");
    gtk_text_buffer_get_bounds(buffer, &start, &end);
    char* shown = gtk_text_buffer_get_text(buffer, &start, &end, TRUE);
    EXPECT_EQ(std::string(shown), changed);
    g_free(shown);
    gtk_text_buffer_get_selection_bounds(buffer, &start, &end);
    EXPECT_EQ(gtk_text_iter_get_line(&start), line);

    // The text changes again before all of it was inserted, and is then emptied.
    view->setText({text + text, "Notes.txt", false});
    view->setText({"short", "Notes.txt", false});
    waitFor([&] { return length() == 5; }, "the short text");
    view->setText({"", "Notes.txt", false});
    EXPECT_EQ(length(), 0);
}

TEST_F(PreviewViewTests, ASourceGetsTheColoursOfItsLanguage)
{
    const auto view = std::make_shared<PreviewTextView>();
    view->setText({"def f():\n    return 1\n", "tram.py", true});
    showPreview(view);
    auto* buffer = gtk_text_view_get_buffer(GTK_TEXT_VIEW(gtk_scrolled_window_get_child(scroller(*view))));
    const auto isColoured = [&] {
        bool found = false;
        gtk_text_tag_table_foreach(
            gtk_text_buffer_get_tag_table(buffer),
            [](GtkTextTag* tag, gpointer flag) {
                gboolean colours = FALSE;
                g_object_get(tag, "foreground-set", &colours, nullptr);
                *static_cast<bool*>(flag) |= colours != FALSE;
            },
            &found);
        return found;
    };
    waitFor(isColoured, "colours");
}

TEST_F(PreviewViewTests, ADamagedRecordingIsSaidToBe)
{
    const auto view = std::make_shared<PreviewMediaView>();
    std::string words;
    view->setOnFailure([&](const std::string& said) { words = said; });
    view->setMedia(
        {folder.write("Broken.wav", "RIFF and then nothing"), "Broken.wav", "audio-x-generic", false});
    showPreview(view);
    waitFor([&] { return !words.empty(); }, "words");
    EXPECT_THAT(words, testing::AnyOf(testing::HasSubstr("damaged"), testing::HasSubstr("cannot play")));
}

/// The widget also has shortcut controllers for itself alone.
bool isWindowWide(gpointer controller)
{
    return GTK_IS_SHORTCUT_CONTROLLER(controller)
        && gtk_shortcut_controller_get_scope(GTK_SHORTCUT_CONTROLLER(controller))
        == GTK_SHORTCUT_SCOPE_GLOBAL;
}

TEST_F(PreviewViewTests, TheKeysOfTheWindowReachTheDocument)
{
    const auto view = std::make_shared<PreviewPagesView>();
    view->setDocument(document(3, "Keys.pdf"), {200, 300});
    int finds = 0;
    view->setOnFind([&] { ++finds; });
    showPreview(view);
    auto* controllers = gtk_widget_observe_controllers(GTK_WIDGET(scroller(*view)));
    int shortcuts = 0;
    for (guint i = 0; i < g_list_model_get_n_items(controllers); ++i) {
        auto* item = g_list_model_get_item(controllers, i);
        for (guint s = 0; isWindowWide(item) && s < g_list_model_get_n_items(G_LIST_MODEL(item)); ++s) {
            auto* shortcut = GTK_SHORTCUT(g_list_model_get_item(G_LIST_MODEL(item), s));
            gtk_shortcut_action_activate(gtk_shortcut_get_action(shortcut),
                static_cast<GtkShortcutActionFlags>(0), GTK_WIDGET(scroller(*view)), nullptr);
            g_object_unref(shortcut);
            ++shortcuts;
        }
        g_object_unref(item);
    }
    g_object_unref(controllers);
    EXPECT_GE(shortcuts, 4);
    EXPECT_EQ(finds, 1);
    // The keys enlarged it, made it smaller and brought it back to the fitting size.
    EXPECT_EQ(view->zoom(), 1);
}

} // namespace
