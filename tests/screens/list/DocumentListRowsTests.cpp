// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// These tests are about the content of the rows in a folder's list.

#include "tests/screens/support/DocumentListFixture.h"

#include "host/drive/identity/DocumentIndex.h"
#include "host/drive/records/ItemFacts.h"
#include "platform/Localization.h"
#include "screens/list/DocumentRows.h"
#include "screens/list/RowThumbnail.h"
#include "tests/support/ForwardingCoordinator.h"

#include <map>
#include <set>

using namespace platform;
using namespace screens;
using namespace testing;
using namespace testing_support;
namespace mark = host::drive::itemMark;

namespace {

using Kind = FolderEntryKind;

struct RowOfKind {
    HandLister::Entry entry;
    std::string detail; ///< the end of the second line
    kit::DownloadState download = kit::DownloadState::Present;
    kit::RowAccessory accessory = kit::RowAccessory::None;
    std::size_t dots = 0;
};

TEST_F(DocumentList, ShowsEveryKindOfItemWithItsDetails)
{
    drive.writeDocument("Stuff/Notes.txt", std::string(1500, 'x'));
    drive.writeDocument("Stuff/Trip/one.txt");
    drive.writeDocument("Stuff/Trip/.hidden");
    drive.writePromise("Stuff/Trip/two.txt", {});
    host::drive::PromiseRecord farAway;
    farAway.size = 2'000'000;
    farAway.tags = {"Red", "Work"};
    drive.writePromise("Stuff/Far.pdf", farAway);
    host::drive::PromiseRecord folder;
    folder.kind = host::drive::PromiseRecord::Kind::Directory;
    drive.writePromise("Stuff/Higher", folder);
    drive.mark(drive.writeDocument("Stuff/Ours.txt", "abc"), mark::shared, "1");
    drive.writeLink("Stuff/Pointer", "Notes.txt");
    drive.makeFolder("Stuff/Letter.pages");
    // A byte that is no text, and a mark that turns what follows.
    const auto bad = std::string("bad\xFF\xE2\x80") + "\xAEgpj.exe";
    drive.writeDocument("Stuff/" + bad);
    const RowOfKind rows[] = {
        {{"Trip", Kind::Folder}, localizedPlural(".DICT.ITEMS.%d", {2}), kit::DownloadState::Present,
            kit::RowAccessory::Disclosure},
        {{bad}, "7 bytes"},
        {{"Far.pdf", Kind::Document, true}, "2 MB", kit::DownloadState::InCloud, kit::RowAccessory::None, 2},
        {{"Higher", Kind::Document, true}, "", kit::DownloadState::InCloud},
        {{"Letter.pages", Kind::Package}, ""},
        {{"Notes.txt"}, "2 KB"},
        {{"Ours.txt"}, "3 bytes · Shared"},
        {{"Pointer", Kind::Link}, "Link to “Notes.txt”"},
    };
    HandLister::Entries entries;
    for (const auto& row : rows)
        entries.push_back(row.entry);
    const auto list = shownList(drive.url("Stuff"));
    deliver(list, entries);

    ASSERT_EQ(list->listView()->rowCount(), std::size(rows));
    for (std::size_t i = 0; i < std::size(rows); ++i) {
        SCOPED_TRACE(rows[i].entry.name);
        const auto shown = list->listView()->row(i);
        EXPECT_THAT(shown.detail, EndsWith(rows[i].detail));
        EXPECT_EQ(shown.download, rows[i].download);
        EXPECT_EQ(shown.accessory, rows[i].accessory);
        EXPECT_EQ(shown.tagDots.size(), rows[i].dots);
        EXPECT_TRUE(shown.image.has_value());
        EXPECT_TRUE(isValidUtf8(shown.title));
    }
    EXPECT_EQ(list->listView()->row(1).title, "bad\uFFFD\uFFFDgpj.exe");
    EXPECT_THAT(list->listView()->row(0).accessibleDescription,
        AllOf(StartsWith("Trip, Folder, "), HasSubstr(rows[0].detail)));
    EXPECT_THAT(list->listView()->row(2).accessibleDescription,
        AllOf(HasSubstr("Far.pdf"), HasSubstr("In the cloud"), HasSubstr("Work")));
    EXPECT_EQ(list->listView()->row(3).accessibleDescription, "Higher, Folder, In the cloud");
    EXPECT_EQ(list->listView()->row(3).image->iconName(), "folder");
}

TEST(DocumentRows, GivesEveryRowAnIdentifierOfItsOwn)
{
    FolderSnapshot::Builder builder(Url::fileURL("/drive"));
    const auto library = Url::fileURL("/libraries/Notes");
    builder.append(FolderSnapshot::ExtraItem{library, "Notes", FolderEntryKind::Library, {}});
    builder.append("Notes", FolderEntryKind::Folder, false);
    builder.append("text", FolderEntryKind::Document, false);
    builder.append("text", FolderEntryKind::Document, true);
    const auto rows = DocumentRows::make(builder.finish(ListingStage::Complete));

    EXPECT_EQ(std::set(rows->ids().begin(), rows->ids().end()).size(), 4U);
    EXPECT_EQ(rows->idFor(library), rows->ids()[0]);
    EXPECT_EQ(rows->idFor(Url::fileURL("/drive/Notes")), rows->ids()[1]);
}

TEST_F(DocumentList, CorrectsTheIndexOfIdentifiersByTheRowsThatItShows)
{
    const auto at = [&](const char* path) { return drive.url(path).path(); };
    const auto indexed = [&](std::uint32_t identifier) {
        return host::drive::DocumentIndex(drive.layout().index()).lookUp(identifier).place.path;
    };
    const auto here = drive.cloud->documentIdentifiers().identify(drive.writeDocument("Documents/here.txt"));
    const auto promised =
        drive.cloud->documentIdentifiers().identify(drive.writePromise("Documents/promised.txt", {}));
    ASSERT_TRUE(here && promised);
    drive.writeDocument("Stuff/unnumbered.txt");
    // Another program moves both.
    std::filesystem::rename(at("Documents/here.txt"), at("Stuff/here.txt"));
    std::filesystem::rename(at("Documents/.promised.txt.trwpromise"), at("Stuff/.promised.txt.trwpromise"));
    drive.settle();
    ASSERT_EQ(indexed(*here), "documents/BrindleDefault/Documents/here.txt");

    const auto list = shownList(drive.url("Stuff"));
    deliver(list, {{"here.txt"}, {"promised.txt", Kind::Document, true}, {"unnumbered.txt"}});
    drive.settle();
    EXPECT_EQ(indexed(*here), "documents/BrindleDefault/Stuff/here.txt");
    EXPECT_EQ(indexed(*promised), "documents/BrindleDefault/Stuff/promised.txt");
    EXPECT_EQ(host::drive::documentIdentifierAt(at("Stuff/unnumbered.txt")), 0U) << "reading gives no number";
    EXPECT_FALSE(std::filesystem::exists(at("Stuff/promised.txt"))) << "reading fetches nothing";
}

TEST_F(DocumentList, ShowsTheLibrariesAtTheTopOfTheDriveAlsoThoseThatComeLater)
{
    const auto root = DocumentListController::createRootList();
    ASSERT_TRUE(root);
    const auto list = shownList(*root->presentedURL());
    const auto change = [&] {
        lister->deliver(root->presentedURL()->deletingLastPathComponent(), {});
        deliver(list, {{"Documents", Kind::Folder}});
    };
    change();
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("Documents")});
    EXPECT_EQ(titles(*list->listView()), (Lines{"Documents"}));
    makePaintLibrary();
    change();
    EXPECT_EQ(titles(*list->listView()), (Lines{"Paint", "Documents"}));
    EXPECT_EQ(list->listView()->row(0).image, Image::named("paint-icon"));
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Documents")});
    const auto listings = lister->listingsStarted();
    change();
    drive.dispatch->advance(2);
    EXPECT_EQ(lister->listingsStarted(), listings) << "nothing changed";

    list->setEditingAnimated(false, false);
    delegate->take();
    list->listView()->activateRow(0);
    EXPECT_EQ(delegate->take(), (Lines{"folder Paint Documents"}));
    drive.signOut();
    drive.settle();
    EXPECT_FALSE(DocumentListController::createRootList());
}

TEST_F(DocumentList, ShowsThumbnailsOfPicturesAndMakesThemAnewWhenTheyChange)
{
    const auto writePicture = [&](int width, int height, unsigned char shade) {
        std::string picture = "P5 " + std::to_string(width) + ' ' + std::to_string(height) + " 255\n";
        picture.append(
            static_cast<std::size_t>(width) * static_cast<std::size_t>(height), static_cast<char>(shade));
        const auto url = drive.writeDocument("Stuff/photo.pgm", picture);
        std::filesystem::last_write_time(
            url.path(), std::filesystem::file_time_type{std::chrono::hours(shade)});
    };
    writePicture(400, 200, 0x40);
    drive.writeDocument("Stuff/broken.pgm", "no picture");
    const auto list = shownList(drive.url("Stuff"));
    const HandLister::Entries entries{{"broken.pgm"}, {"photo.pgm"}};
    deliver(list, entries);
    EXPECT_TRUE(list->listView()->row(0).image->isNamed());
    const auto first = *list->listView()->row(1).image;
    ASSERT_FALSE(first.isNamed());
    EXPECT_EQ(first.pixelWidth(), rowThumbnailSide);
    EXPECT_EQ(first.pixelHeight(), rowThumbnailSide / 2);
    EXPECT_EQ(first.pixels().at(20 * rowThumbnailSide + 40), 0xff404040U);
    EXPECT_EQ(first.pixels().front(), 0xff363636U) << "a darker edge";

    deliver(list, entries);
    EXPECT_EQ(list->listView()->row(1).image, first) << "not made again while nothing changed";

    writePicture(30, 60, 0x80);
    deliver(list, entries);
    const auto second = *list->listView()->row(1).image;
    EXPECT_EQ(second.pixelHeight(), 60);
    EXPECT_EQ(second.pixels().at(30 * 30 + 15), 0xff808080U);
}

/// Records the names of the items that are read.
struct RecordingCoordinator : ForwardingCoordinator {
    using ForwardingCoordinator::ForwardingCoordinator;
    Failure coordinateReading(const Url& url, ReadingOptions options, const Accessor& accessor) override
    {
        names.push_back(url.lastPathComponent());
        return real->coordinateReading(url, options, accessor);
    }
    Lines names;
};

TEST_F(DocumentList, ReadsDetailsOfVisibleRowsOnly)
{
    auto set = drive.installed;
    const auto coordinator = std::make_shared<RecordingCoordinator>(drive.fileCoordinator);
    set.fileCoordinator = coordinator;
    set.folderLister = lister;
    installServices(std::move(set));
    const auto list = shownList(drive.makeFolder("Stuff"));
    const auto all = documents(10'000);
    lister->deliver(*list->presentedURL(), {all.begin(), all.begin() + 100}, ListingStage::FirstRows);
    EXPECT_EQ(list->containedItemCount(), 100U);
    deliver(list, all);
    EXPECT_EQ(list->containedItemCount(), 10'000U);
    const auto visible = list->listView()->visibleRows();
    EXPECT_LT(visible.count, 20U);
    // The details of the first rows were wanted twice: when the rows came, and when the list was complete.
    EXPECT_LE(coordinator->names.size(), 2 * visible.count);

    coordinator->names.clear();
    list->listView()->userScrolled({0, 5000 * list->listView()->rowHeight()});
    list->listView()->userScrolled({0, 9000 * list->listView()->rowHeight()});
    drive.dispatch->runUntilIdle();
    ASSERT_FALSE(coordinator->names.empty());
    EXPECT_LT(coordinator->names.size(), 20U);
    EXPECT_THAT(coordinator->names, Each(Ge("item 109000")));
}

TEST_F(DocumentList, ShowsChangedDetailsWithoutTouchingOtherRows)
{
    drive.writeDocument("Stuff/a.txt", "1");
    drive.writeDocument("Stuff/b.txt", "1");
    const auto list = shownList(drive.url("Stuff"));
    deliver(list, {{"a.txt"}, {"b.txt"}});
    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);

    drive.writeDocument("Stuff/b.txt", "12345");
    lister->deliver(*list->presentedURL(), {{"a.txt"}, {"b.txt"}});
    EXPECT_THAT(list->listView()->row(1).detail, HasSubstr("1 byte"));
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(list->listView()->row(1).detail, HasSubstr("5 bytes"));
    EXPECT_THAT(observer->changedRows, ElementsAre(1U));
}

TEST_F(DocumentList, PaintsTheDotsAnewWhenTheTableOfTagsChanges)
{
    struct Colors : RecordingListDelegate {
        std::vector<kit::TagDot> documentListControllerDotsForTagNames(
            const DocumentListControllerDelegate::List&, const std::vector<std::string>& names) override
        {
            return {names.size(), {color, Color::white()}};
        }
        Color color = Color::gray(0.25F);
    };
    const auto colors = std::make_shared<Colors>();
    drive.mark(drive.writeDocument("Stuff/b.txt"), mark::tags, "Work");
    drive.writeDocument("Stuff/a.txt");
    const auto list = shownList(drive.url("Stuff"));
    list->setDelegate(colors);
    deliver(list, {{"a.txt"}, {"b.txt"}});
    const auto row = [&] { return list->listView()->row(1); };
    ASSERT_THAT(row().tagDots, ElementsAre(kit::TagDot{colors->color, Color::white()}));
    // Who knows the colours hears of the change after the list.
    const auto later = drive.notifications->observe(Notification::KeyValueStoreDidChangeExternally,
        [&](const auto&) { colors->color = Color::gray(0.75F); });

    struct Painted : RecordingListObserver {
        void rowDidChange(kit::ListView& view, std::size_t index) override
        {
            dots[index] = view.row(index).tagDots;
        }
        std::map<std::size_t, std::vector<kit::TagDot>> dots;
    };
    const auto painted = std::make_shared<Painted>();
    list->listView()->setListObserver(painted);
    drive.notifications->post(Notification::KeyValueStoreDidChangeExternally);
    drive.settle();
    EXPECT_THAT(
        painted->dots, ElementsAre(Pair(1U, ElementsAre(kit::TagDot{Color::gray(0.75F), Color::white()}))));
}

TEST_F(DocumentList, DownloadsADocumentAndShowsHowFarItIs)
{
    host::drive::PromiseRecord far;
    far.size = 4'000'000;
    far.content = "far";
    std::filesystem::create_directories(drive.layout().cloud());
    std::ofstream(drive.layout().cloud() + "/far") << std::string(4'000'000, 'x');
    drive.writePromise("Stuff/far.txt", far);
    const auto list = shownList(drive.url("Stuff"));
    auto& items = platform::services().cloudDocumentService().items();
    list->setDownloadVerbs({.download = [&](const auto& wanted) { items.download(wanted.front(), {}); },
        .remove = {},
        .showRunning = {}});
    deliver(list, {{"far.txt", Kind::Document, true}, {"here.txt"}});
    const auto row = [&] { return list->listView()->row(0); };
    const auto choose = [&](const std::string& title) {
        ASSERT_EQ(list->listView()->menuForRow(0).front().title, title);
        list->listView()->menuForRow(0).front().handler();
    };
    EXPECT_TRUE(list->listView()->menuForRow(1).empty());
    choose("Download");
    EXPECT_EQ(row().download, kit::DownloadState::Downloading);
    EXPECT_THAT(row().accessibleDescription, HasSubstr("Downloading"));
    choose("Cancel Download");
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(row().download, kit::DownloadState::InCloud);

    struct Shares : RecordingListObserver {
        void rowDidChange(kit::ListView& view, std::size_t index) override
        {
            shares.push_back(view.row(index).downloadProgress);
        }
        std::vector<double> shares;
    };
    const auto observer = std::make_shared<Shares>();
    list->listView()->setListObserver(observer);
    choose("Download");
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(observer->shares, Contains(AllOf(Gt(0.2), Lt(0.9))));
    EXPECT_TRUE(std::filesystem::exists(drive.url("Stuff/far.txt").path()));
}

} // namespace
