// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/UchardetDecoder.h"
#include "kit/controllers/NavigationController.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/Label.h"
#include "kit/views/TextField.h"
#include "screens/PlaceholderView.h"
#include "screens/preview/PreviewContent.h"
#include "screens/preview/PreviewController.h"
#include "screens/preview/PreviewLoader.h"
#include "screens/preview/PreviewPictureView.h"
#include "screens/preview/PreviewScreenView.h"
#include "screens/preview/PreviewSearchBar.h"
#include "screens/preview/PreviewTextView.h"
#include "screens/preview/PreviewToolbar.h"
#include "screens/preview/TextDecoding.h"
#include "tests/screens/support/ScreensFixture.h"
#include "tests/support/SimplePdf.h"

#include <sys/stat.h>

using namespace platform;
using namespace screens;
using testing::HasSubstr;
using testing_support::ScreensFixture;
using Kind = PreviewContent::Kind;

namespace {

/// Shows the documents that the test puts in.
struct Documents : PreviewControllerDataSource {
    std::size_t numberOfPreviewItemsInPreviewController(const PreviewController&) const override
    {
        return urls.size();
    }
    Url previewControllerPreviewItemAtIndex(const PreviewController&, std::size_t index) const override
    {
        return urls[index];
    }
    std::vector<Url> urls;
};

class Preview : public ScreensFixture {
protected:
    Preview()
    {
        screen->setDataSource(documents);
        screen->view()->setFrame({0, 0, 360, 600});
    }
    void show(std::vector<Url> urls)
    {
        documents->urls = std::move(urls);
        screen->reloadData();
    }
    /// Shows a document and runs what follows.
    void open(const Url& url)
    {
        show({url});
        drive.dispatch->runUntilIdle();
    }
    void readAgain() const
    {
        screen->refreshCurrentPreviewItem();
        drive.dispatch->runUntilIdle();
    }
    const PlaceholderView::Content& summary() const
    {
        const auto view = std::dynamic_pointer_cast<PlaceholderView>(screen->screenView()->content());
        static const PlaceholderView::Content none;
        return view ? view->content() : none;
    }

    std::shared_ptr<Documents> documents = std::make_shared<Documents>();
    std::shared_ptr<PreviewController> screen = std::make_shared<PreviewController>();
};

constexpr std::string_view twoPixels = "P6 2 1 255\n\xFF\x80\x01\x02\x03\x04";

struct Row {
    const char* name;
    std::string_view content;
    Kind kind;
    const char* note; ///< a part of the note
};

TEST_F(Preview, ChoosesWhatToShowByTheDocument)
{
    const auto secret = testing_support::passwordPdf(), plan = testing_support::simplePdf({"one", "two"}),
               pageless = testing_support::simplePdf({});
    const Row rows[] = {
        {"Good.pdf", plan, Kind::Pages, ""},
        {"Picture.png", twoPixels, Kind::Image, ""},
        {"Broken.png", "no picture at all", Kind::Failure, "damaged"},
        {"Notes.txt", "Hello", Kind::Text, ""},
        {"Empty.txt", "", Kind::Text, "empty"},
        {"Plan.pdf", "%PDF-1.4", Kind::Failure, "damaged"},
        {"Pageless.pdf", pageless, Kind::Failure, "damaged"},
        {"Secret.pdf", secret, Kind::Failure, "password"},
        {"Song.wav", "RIFF", Kind::Sound, "4 bytes"},
        {"Film.mp4", "ftyp", Kind::Film, "4 bytes"},
        {"Unknown.xyz", "bytes", Kind::Summary, "5 bytes"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        show({drive.writeDocument(row.name, row.content)});
        EXPECT_FALSE(screen->content());
        drive.dispatch->runUntilIdle();
        ASSERT_TRUE(screen->content());
        EXPECT_EQ(screen->content()->kind, row.kind);
        EXPECT_EQ(screen->title(), row.name);
        EXPECT_THAT(screen->content()->note, HasSubstr(row.note));
    }
}

TEST_F(Preview, SaysWhyADocumentCannotBeShown)
{
    open(drive.url("Gone.txt"));
    EXPECT_EQ(screen->content()->kind, Kind::Failure);
    EXPECT_FALSE(summary().message.empty());

    open(drive.writePromise("Far.txt", {}));
    EXPECT_EQ(screen->content()->kind, Kind::InCloud);
    EXPECT_THAT(summary().message, HasSubstr("in the cloud"));
    EXPECT_FALSE(std::filesystem::exists(drive.url("Far.txt").path()));

    // Opening a pipe would block a reader for ever.
    ASSERT_EQ(::mkfifo(drive.url("Pipe.txt").path().c_str(), 0600), 0);
    open(drive.url("Pipe.txt"));
    EXPECT_EQ(screen->content()->kind, Kind::Summary);

    show({});
    EXPECT_EQ(summary().title, "Nothing to show");
}

TEST_F(Preview, CutsLongTextsAndSaysSo)
{
    const PreviewLimits limits;
    std::string text(limits.maxTextBytes - 1, 'x');
    for (std::size_t line = 100; line < text.size(); line += 100)
        text[line] = '\n';
    drive.writeDocument("Fits.txt", text + "y");
    drive.writeDocument("Long.txt", text + "\xC3\xA4 and more");
    const auto whole = loadPreview(drive.url("Fits.txt"), limits);
    EXPECT_EQ(whole.text.size(), limits.maxTextBytes);
    EXPECT_EQ(whole.note, "");
    const auto cut = loadPreview(drive.url("Long.txt"), limits);
    EXPECT_EQ(cut.text.size(), limits.maxTextBytes - 1);
    EXPECT_THAT(cut.note, HasSubstr("Only the beginning"));

    const auto lines = loadPreview(
        drive.writeDocument("Line.txt", "short\n" + std::string(limits.maxLineBytes + 1, 'x') + "\nend"),
        limits);
    EXPECT_THAT(lines.text, testing::EndsWith("x…\nend"));
    EXPECT_THAT(lines.note, HasSubstr("very long lines"));
    for (const auto& [file, lineEnd] : {std::pair("Mac.txt", "\r"), {"Windows.txt", "\r\n"}}) {
        std::string many;
        while (many.size() <= limits.maxLineBytes)
            many += std::string("line") + lineEnd;
        EXPECT_EQ(loadPreview(drive.writeDocument(file, many), limits).text, many);
    }

    open(drive.url("Long.txt"));
    screen->view()->layoutIfNeeded();
    EXPECT_EQ(screen->screenView()->note(), cut.note);
    EXPECT_GT(screen->previewView()->frame().y, 0);
}

TEST_F(Preview, ReadsNoMorePixelsThanAreSeen)
{
    kit::Screen::setMain(kit::Screen{{0, 0, 10, 5}, 2, kit::UserInterfaceIdiom::Phone, {}});
    std::string picture = "P6 100 100 255\n";
    picture.append(30'000, 'z');
    open(drive.writeDocument("Large.png", picture));
    const auto view = std::dynamic_pointer_cast<PreviewPictureView>(screen->previewView());
    ASSERT_TRUE(view);
    EXPECT_EQ(view->picture().frames.front().image.pixelHeight(), 10);
    // When the picture is enlarged, its file is read once more.
    view->userSeesPixels(11);
    view->userSeesPixels(50);
    drive.dispatch->runUntilIdle();
    kit::Screen::setMain(std::nullopt);
    EXPECT_EQ(screen->previewView(), view);
    EXPECT_EQ(view->picture().frames.front().image.pixelHeight(), 100);
}

TEST_F(Preview, IgnoresWhatArrivesForAnEarlierDocument)
{
    const auto first = drive.writeDocument("First.txt", "first");
    const auto second = drive.writeDocument("Second.txt", "second");
    show({first});
    open(second);
    EXPECT_EQ(screen->content()->text, "second");
    EXPECT_EQ(screen->currentPreviewItem(), second);
}

TEST_F(Preview, ShowsThatItIsLoadingOnlyAfterAWhile)
{
    const auto late = std::make_shared<PreviewController>();
    documents->urls = {drive.writeDocument("Notes.txt", "Hello")};
    late->setDataSource(documents);
    late->reloadData();
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(late->view()->frame().width, 0);
    const auto text = std::dynamic_pointer_cast<PreviewTextView>(late->screenView()->content());
    ASSERT_TRUE(text);
    EXPECT_EQ(text->text().text, "Hello");
    drive.dispatch->advance(1);
    EXPECT_EQ(late->screenView()->content(), text);
}

class Download : public Preview {
protected:
    Download()
    {
        host::drive::PromiseRecord promise;
        promise.size = 5;
        promise.content = "content";
        far = drive.writePromise("Far.txt", promise);
        std::filesystem::create_directories(drive.layout().cloud());
    }
    void putContent() const { std::ofstream(drive.layout().cloud() + "/content") << "Hello"; }
    void appear() const
    {
        screen->beginAppearance(true, false);
        screen->endAppearance();
    }
    /// Answers the first button below the text.
    std::shared_ptr<kit::Button> button() const
    {
        const auto view = std::dynamic_pointer_cast<PlaceholderView>(screen->screenView()->content());
        return view->buttons().front();
    }
    void pressButton() const
    {
        button()->press();
        drive.dispatch->runUntilIdle();
    }
    std::optional<Url> far;
};

TEST_F(Download, BeginsWhenThePersonHasComeAndCanBeStoppedAndBegunAgain)
{
    putContent();
    open(*far);
    EXPECT_EQ(screen->content()->kind, Kind::InCloud);
    EXPECT_EQ(button()->title(), "Download");
    appear();
    EXPECT_TRUE(screen->isDownloading());
    EXPECT_THAT(summary().message, HasSubstr("Downloading"));
    EXPECT_EQ(button()->title(), "Cancel");
    pressButton();
    EXPECT_FALSE(std::filesystem::exists(far->path()));
    EXPECT_THAT(summary().message, HasSubstr("in the cloud"));
    // A notice of a change does not start the download that the user stopped.
    readAgain();
    EXPECT_FALSE(screen->isDownloading());
    pressButton();
    EXPECT_FALSE(screen->isDownloading());
    EXPECT_EQ(screen->content()->text, "Hello");
}

TEST_F(Download, SaysWhyItFailedAndTriesAgain)
{
    show({*far});
    appear();
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(screen->content()->kind, Kind::Failure);
    EXPECT_THAT(summary().message, HasSubstr("could not be downloaded"));
    EXPECT_EQ(button()->title(), "Try Again");
    putContent();
    pressButton();
    EXPECT_EQ(screen->content()->text, "Hello");
}

TEST_F(Download, EndsWhenThePersonGoesBack)
{
    putContent();
    open(*far);
    const auto stack = std::make_shared<kit::NavigationController>();
    const auto list = std::make_shared<kit::ViewController>();
    stack->setViewControllers({list, screen}, false);
    stack->beginAppearance(true, false);
    stack->endAppearance();
    EXPECT_TRUE(screen->isDownloading());
    // The download goes on while another screen lies above.
    stack->pushViewController(std::make_shared<kit::ViewController>(), false);
    EXPECT_TRUE(screen->isDownloading());
    stack->setViewControllers({list}, false);
    EXPECT_FALSE(screen->isDownloading());
    drive.dispatch->runUntilIdle();
    EXPECT_FALSE(std::filesystem::exists(far->path()));
    EXPECT_FALSE(screen->content());
    // The content is read again when the user returns to the screen.
    stack->pushViewController(screen, false);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(screen->content()->text, "Hello");
}

TEST_F(Preview, KeepsTheViewWhileADocumentIsDamagedForAWhile)
{
    const auto url = drive.writeDocument("Plan.pdf", testing_support::simplePdf({"one", "two"}));
    open(url);
    const auto view = screen->previewView();
    view->setZoom(3);
    drive.writeDocument("Plan.pdf", "%PDF");
    readAgain();
    EXPECT_THAT(summary().message, HasSubstr("damaged"));
    EXPECT_TRUE(screen->screenView()->toolbar()->isHidden());
    drive.writeDocument("Plan.pdf", testing_support::simplePdf({"one", "two", "three"}));
    readAgain();
    EXPECT_EQ(screen->screenView()->content(), view);
    EXPECT_EQ(view->zoom(), 3);
    EXPECT_EQ(screen->screenView()->toolbar()->pageLabel()->text(), "1 of 3");
}

TEST_F(Preview, SearchesFromItsBar)
{
    open(drive.writeDocument("Plan.pdf", testing_support::simplePdf({"hay", "needle"})));
    screen->view()->layoutIfNeeded();
    const auto& bars = *screen->screenView();
    ASSERT_TRUE(bars.toolbar()->findButton()->press());
    EXPECT_TRUE(bars.isSearching());
    EXPECT_FALSE(bars.searchBar()->nextButton()->press());
    bars.searchBar()->field()->userEdited("need", {4, 0});
    bars.searchBar()->field()->userEdited("needle", {6, 0});
    drive.dispatch->advance(1);
    EXPECT_EQ(bars.searchBar()->countLabel()->text(), "1 of 1");
    EXPECT_TRUE(bars.searchBar()->nextButton()->press());
    // The back key first ends the search and then leaves the screen.
    EXPECT_TRUE(screen->backRequested());
    EXPECT_FALSE(bars.isSearching());
    EXPECT_EQ(screen->previewView()->query(), "");
    EXPECT_FALSE(screen->backRequested());
}

struct TextRow {
    const char* name;
    std::string_view bytes;
    TextEnd end;
    const char* text;
};

TEST(TextDecoding, UnderstandsTheUsualEncodings)
{
    using namespace std::string_view_literals;
    const TextRow rows[] = {
        {"UTF-8", "Gr\xC3\xBC\xC3\x9F", TextEnd::Whole, "Grüß"},
        {"UTF-8 with mark", "\xEF\xBB\xBFhi", TextEnd::Whole, "hi"},
        {"Latin-1", "Gr\xFC\xDF", TextEnd::Whole, "Grüß"},
        {"UTF-16 little-endian", "\xFF\xFEh\0\xFC\0"sv, TextEnd::Whole, "hü"},
        {"UTF-16 big-endian, beyond the first plane", "\xFE\xFF\xD8\x3D\xDE\x00"sv, TextEnd::Whole, "😀"},
        {"UTF-16 without a mark", "h\0e\0y\0\n\0"sv, TextEnd::Whole, "hey\n"},
        {"UTF-32 little-endian", "\xFF\xFE\0\0\xFC\0\0\0"sv, TextEnd::Whole, "ü"},
        {"UTF-32 big-endian, no character", "\0\0\xFE\xFF\0\x11\0\0"sv, TextEnd::Whole, "\uFFFD"},
        {"Windows-1252", "\x93q\x94 \x80", TextEnd::Whole, "“q” €"},
        {"ISO-2022-JP", "\033$BEl5~$+$i5~ET$^$G!#\033(B", TextEnd::Whole, "東京から京都まで。"},
        {"Windows-1256",
            "\307\341\336\330\307\321 \343\344 \307\341\336\307\345\321\311 \355\323\312\333\321\336 "
            "\323\307\332\312\355\344.",
            TextEnd::Whole, "القطار من القاهرة يستغرق ساعتين."},
        {"Shift-JIS cut within a character",
            "\223\214\213\236\202\251\202\347\213\236\223s\202\334\202\305\220V\212\262\220\374\202\305\223"
            "\361\216\236\212",
            TextEnd::Cut, "東京から京都まで新幹線で二時"},
        {"UTF-16 with a lone surrogate", "\xFE\xFF\xDE\x00\0a"sv, TextEnd::Whole, "\uFFFDa"},
        {"UTF-16 with half a unit", "\xFF\xFEh\0i"sv, TextEnd::Whole, "h"},
        {"UTF-8 cut within a character", "ab\xE2\x82", TextEnd::Cut, "ab"},
        {"UTF-8 cut between characters", "ab\xE2\x82\xAC", TextEnd::Cut, "ab€"},
        {"UTF-16 cut within a pair", "\xFE\xFF\0a\xD8\x3D"sv, TextEnd::Cut, "a"},
        {"whole, with the end of a character missing", "ab\xE2\x82", TextEnd::Whole, "abâ‚"},
        {"NUL characters", "a\0b"sv, TextEnd::Whole, "ab"},
        {"nothing", "", TextEnd::Cut, ""},
    };
    const host::previews::UchardetDecoder older;
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ(decodedText(row.bytes, row.end, older), row.text);
        EXPECT_TRUE(isValidUtf8(decodedText(row.bytes, row.end, older)));
    }
}

} // namespace
