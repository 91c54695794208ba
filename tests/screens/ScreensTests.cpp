// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/ScreensFixture.h"

#include "kit/views/ImageView.h"
#include "kit/views/View.h"
#include "platform/Localization.h"
#include "screens/DocumentIcon.h"
#include "screens/DocumentInteractionSheet.h"
#include "screens/PlaceholderView.h"
#include "screens/UnavailableScreen.h"
#include "screens/UpgradeFlow.h"

using namespace platform;
using namespace screens;
using namespace testing;
using namespace testing_support;

namespace {

struct CountingSheetDelegate : DocumentInteractionSheetDelegate {
    void documentInteractionControllerDidDismissOptionsMenu(
        const std::shared_ptr<DocumentInteractionSheet>&) override
    {
        ++dismissed;
    }
    int dismissed = 0;
};

class Screens : public ScreensFixture {
protected:
    /// Shows the menu of an item and answers its lines.
    Lines offeredFor(const Url& url)
    {
        sheet = DocumentInteractionSheet::interactionControllerWithURL(url);
        sheet->setDelegate(told);
        sheet->presentOptionsMenuFromRectInView(screen, {0, 0, 10, 0}, screen->view(), false);
        return titles();
    }
    std::shared_ptr<kit::AlertController> alert() const { return alertOver(*screen); }
    Lines titles() const
    {
        Lines found;
        for (const auto& action : alert()->actions())
            found.push_back(action->title());
        return found;
    }
    void choose(const std::string& title) const
    {
        pressTitled(alert(), title);
        drive.settle();
    }

    std::shared_ptr<kit::ViewController> screen = std::make_shared<kit::ViewController>();
    std::shared_ptr<DocumentInteractionSheet> sheet;
    std::shared_ptr<CountingSheetDelegate> told = std::make_shared<CountingSheetDelegate>();
};

TEST_F(Screens, ShowTheIconOfADocumentInItsSize)
{
    const struct {
        const char *type, *name, *icon;
    } rows[] = {{"public.pdf", "a.txt", "x-office-document"}, {"", "a.png", "image-x-generic"},
        {"public.data", "a.PNG", "image-x-generic"}, {"", "a", "text-x-generic"},
        {"public.directory", "a.png", "folder"}};
    for (const auto& row : rows) {
        const auto icon = documentIcon(row.type, row.name, DocumentIconFormat::Large);
        EXPECT_EQ(icon.iconName(), row.icon) << row.type << ' ' << row.name;
        EXPECT_EQ(icon.size(), (Size{64, 64}));
        EXPECT_EQ(kit::ImageView(icon).intrinsicContentSize(), (Size{64, 64}));
        EXPECT_NE(icon, Image::named(row.icon)) << "an icon without a size is given one where it is shown";
    }
    EXPECT_EQ(kit::ImageView(Image::named("folder")).intrinsicContentSize(),
        (Size{kit::ImageView::noIntrinsicMetric, kit::ImageView::noIntrinsicMetric}));
}

TEST_F(Screens, OfferWhatFitsTheItem)
{
    const auto report = drive.writeDocument("Report.pdf"), note = drive.writeDocument("note.txt"),
               folder = drive.makeFolder("Stuff"), far = drive.writePromise("Far.pdf", {});
    apps->available = {{"Alternate", {SimulatedApps::make("editor"), SimulatedApps::make("importer", false)}},
        {"Owner", {SimulatedApps::make("editor"), SimulatedApps::make("own")}}};
    EXPECT_THAT(offeredFor(report),
        ElementsAre("Open in The editor", "Send by Mail", "Copy Path", "Copy Link", "Show in File Manager",
            "Print", "Cancel"));
    EXPECT_EQ(alert()->title(), "Report.pdf");
    choose("Cancel");
    sharing->hasMailer = false;
    EXPECT_THAT(offeredFor(note),
        ElementsAre("Open in The editor", "Copy Path", "Copy Link", "Show in File Manager", "Cancel"));
    choose("Cancel");
    apps->available.clear();
    sharing->hasMailer = true;
    EXPECT_THAT(offeredFor(folder), ElementsAre("Copy Path", "Copy Link", "Show in File Manager", "Cancel"));
    choose("Cancel");
    EXPECT_THAT(offeredFor(far), ElementsAre("Copy Path", "Copy Link", "Cancel"));
    EXPECT_FALSE(alert()->message().empty()) << "it says that the content is not here";
    choose("Cancel");
    EXPECT_EQ(told->dismissed, 4);
}

TEST_F(Screens, DoWhatWasChosenOnce)
{
    const auto report = drive.writeDocument("100% & more.pdf");
    for (const auto* title : {"Send by Mail", "Copy Path", "Copy Link", "Show in File Manager", "Print"}) {
        offeredFor(report);
        choose(title);
        EXPECT_EQ(alert(), nullptr) << title;
    }
    const auto folder = report.deletingLastPathComponent().path();
    EXPECT_THAT(sharing->lines,
        ElementsAre("mail 100% & more.pdf", "copy " + report.path(),
            "copy tarrowdriveapp://" + folder + "/100%2525%2520&%2520more.pdf", "show 100% & more.pdf",
            "print 100% & more.pdf"));
    EXPECT_EQ(told->dismissed, 5);
}

TEST_F(Screens, OpenInAnyOfManyAppsAndSayWhenOneDoesNotStart)
{
    const auto note = drive.writeDocument("note.txt");
    std::vector<AppHandle> many;
    for (const auto* name : {"a", "b", "c", "d", "e"})
        many.push_back(SimulatedApps::make(name));
    apps->available = {{"Owner", many}};
    EXPECT_EQ(offeredFor(note)[DocumentInteractionSheet::directApps], "Other Apps…");
    choose("Other Apps…");
    EXPECT_THAT(titles(), ElementsAre("Open in The d", "Open in The e", "Cancel"));
    choose("Open in The e");
    EXPECT_THAT(apps->opened, ElementsAre(SimulatedApps::Opened{note, "e"}));

    apps->appsStart = false;
    offeredFor(note);
    choose("Open in The a");
    EXPECT_EQ(alert()->title(), "The a could not be started");
    choose("OK");
    sharing->answer = Error(FileErrorCode::Unsupported);
    offeredFor(note);
    choose("Send by Mail");
    ASSERT_TRUE(alert());
    EXPECT_THAT(titles(), ElementsAre("OK"));
}

TEST_F(Screens, OpenAnOffersPageOnlyWhenAskedTo)
{
    UpgradeFlow::initWithOffer(nullptr)->beginWithPresentingViewController(screen);
    EXPECT_FALSE(alert());

    StorageOffer offer;
    offer.link.target = "https://example.org/more";
    const auto flow = UpgradeFlow::initWithOffer(std::make_shared<const StorageOffer>(offer));
    flow->beginWithPresentingViewController(screen);
    choose("Cancel");
    EXPECT_THAT(links->opened, IsEmpty());

    links->answer = Error(FileErrorCode::Unsupported);
    flow->beginWithPresentingViewController(screen);
    choose("Open Page");
    EXPECT_THAT(links->opened, ElementsAre("https://example.org/more"));
    ASSERT_TRUE(alert());
    EXPECT_EQ(alert()->title(), "The page cannot be opened");
}

TEST_F(Screens, TellWhoIsNotSignedInWhatToDo)
{
    for (const double width : {360.0, 1024.0}) {
        const auto view = UnavailableScreen::create()->view();
        view->setFrame({0, 0, width, 640});
        view->layoutIfNeeded();
        const auto& text = view->subviews().front()->frame();
        EXPECT_GE(text.x, 20);
        EXPECT_LE(text.maxX(), width - 20);
        EXPECT_LE(text.width, PlaceholderView::maximumWidth);
        EXPECT_NEAR(text.midX(), width / 2, 1);
    }
}

} // namespace
