#include "tests/components/support/ComponentsFixture.h"

#include "host/drive/ContainerRecord.h"
#include "host/drive/ItemFacts.h"
#include "platform/Localization.h"
#include "platform/components/FolderPlaces.h"
#include "platform/components/PlaceholderView.h"
#include "platform/components/RowThumbnail.h"
#include "platform/components/UnavailableScreen.h"
#include "platform/ui/AlertController.h"
#include "platform/ui/ListView.h"
#include "platform/ui/ListViewObserver.h"
#include "platform/ui/NavigationItem.h"
#include "platform/ui/SearchPresentation.h"

#include <gmock/gmock.h>

#include <cerrno>
#include <filesystem>
#include <fstream>

using namespace platform;
using namespace platform::components;
using testing::ElementsAre;
using testing::HasSubstr;
using testing_support::ComponentsFixture;
using testing_support::HandLister;
namespace mark = host::drive::itemMark;

namespace {

using Kind = FolderEntryKind;
using Lines = std::vector<std::string>;

class DocumentList : public ComponentsFixture { };

/// Writes down the exact changes that a list's peer is told.
struct RecordingListObserver : ui::ListViewObserver {
    void rowsWereReset(ui::ListView&) override { ++resets; }
    void rowsDidChange(ui::ListView&, const ui::ListChanges& changes) override { last = changes; }
    void rowDidChange(ui::ListView&, std::size_t index) override { changedRows.push_back(index); }
    void selectionDidChange(ui::ListView&) override { }
    void scrollToRow(ui::ListView&, std::size_t, ui::RowPosition, bool) override { }
    void focusRow(ui::ListView&, std::size_t) override { }
    void refreshStateDidChange(ui::ListView&) override { }

    int resets = 0;
    ui::ListChanges last;
    std::vector<std::size_t> changedRows;
};

HandLister::Entries documents(std::size_t count)
{
    HandLister::Entries entries;
    for (std::size_t i = 0; i < count; ++i)
        entries.push_back({"item " + std::to_string(100'000 + i) + ".txt"});
    return entries;
}

Url makePaintLibrary(const testing_support::DriveFixture& drive)
{
    host::drive::ContainerRecord record;
    record.names = {{"en", "Paint"}};
    record.iconName = "paint-icon";
    return drive.makeContainer("com.example.paint", record);
}

struct RowOfKind {
    HandLister::Entry entry;
    std::string detail; ///< the end of the second line
    ui::DownloadState download = ui::DownloadState::Present;
    ui::RowAccessory accessory = ui::RowAccessory::None;
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
    drive.mark(drive.writeDocument("Stuff/Ours.txt", "abc"), mark::shared, "1");
    drive.writeLink("Stuff/Pointer", "Notes.txt");
    drive.makeFolder("Stuff/Letter.pages");
    drive.writeDocument("Stuff/bad\xFF\u202Egpj.exe");
    const RowOfKind rows[] = {
        {{"Trip", Kind::Folder}, localizedPlural(".DICT.ITEMS.%d", {2}), ui::DownloadState::Present,
            ui::RowAccessory::Disclosure},
        {{"bad\xFF\u202Egpj.exe"}, "7 bytes"},
        {{"Far.pdf", Kind::Document, true}, "2 MB", ui::DownloadState::InCloud, ui::RowAccessory::None, 2},
        {{"Letter.pages", Kind::Package}, ""},
        {{"Notes.txt"}, "2 KB"},
        {{"Ours.txt"}, "3 bytes · Shared"},
        {{"Pointer", Kind::Link}, "Link"},
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
        EXPECT_THAT(shown.detail, testing::EndsWith(rows[i].detail));
        EXPECT_EQ(shown.download, rows[i].download);
        EXPECT_EQ(shown.accessory, rows[i].accessory);
        EXPECT_EQ(shown.tagColors.size(), rows[i].dots);
        EXPECT_TRUE(shown.image.has_value());
        EXPECT_TRUE(isValidUtf8(shown.title));
    }
    EXPECT_EQ(list->listView()->row(1).title, "bad\uFFFD\uFFFDgpj.exe");
    EXPECT_THAT(list->listView()->row(0).accessibleDescription,
        testing::AllOf(testing::StartsWith("Trip, Folder, "), HasSubstr(rows[0].detail)));
    EXPECT_THAT(list->listView()->row(2).accessibleDescription,
        testing::AllOf(HasSubstr("Far.pdf"), HasSubstr("In the cloud"), HasSubstr("Work")));
}

TEST_F(DocumentList, ShowsTheLibrariesAtTheTopOfTheDrive)
{
    makePaintLibrary(drive);
    const auto root = DocumentListController::createRootList();
    ASSERT_TRUE(root);
    const auto list = shownList(*root->presentedURL());
    deliver(list, {{"Documents", Kind::Folder}});
    EXPECT_EQ(titles(list), (Lines{"Paint", "Documents"}));
    EXPECT_EQ(list->listView()->row(0).image, Image::named("paint-icon"));
    EXPECT_EQ(list->containedItems().back(), drive.url("Documents"));

    delegate->take();
    list->listView()->activateRow(0);
    EXPECT_EQ(delegate->take(), (Lines{"folder Paint Documents"}));

    drive.signOut();
    drive.settle();
    EXPECT_FALSE(DocumentListController::createRootList());
}

TEST_F(DocumentList, ShowsLibrariesThatComeWhileItIsShown)
{
    const auto root = DocumentListController::createRootList();
    const auto list = shownList(*root->presentedURL());
    deliver(list, {{"Documents", Kind::Folder}});
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("Documents")});
    EXPECT_EQ(titles(list), (Lines{"Documents"}));
    makePaintLibrary(drive);
    lister->deliver(root->presentedURL()->deletingLastPathComponent(), {});
    deliver(list, {{"Documents", Kind::Folder}});
    EXPECT_EQ(titles(list), (Lines{"Paint", "Documents"}));
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Documents")});
    const auto listings = lister->listingsStarted();
    lister->deliver(root->presentedURL()->deletingLastPathComponent(), {});
    drive.dispatch->advance(2);
    EXPECT_EQ(lister->listingsStarted(), listings) << "nothing changed";
}

TEST_F(DocumentList, ShowsThumbnailsOfPicturesAndMakesThemAnewWhenTheyChange)
{
    const auto writePicture = [&](int width, int height, unsigned char shade) {
        std::string picture = "P5 " + std::to_string(width) + ' ' + std::to_string(height) + " 255\n";
        picture.append(static_cast<std::size_t>(width * height), static_cast<char>(shade));
        const auto url = drive.writeDocument("Stuff/photo.pgm", picture);
        std::filesystem::last_write_time(
            url.path(), std::filesystem::file_time_type{std::chrono::hours(shade)});
        // Asked on the main thread, as here, the store makes a thumbnail later and has it from then on.
        readRowThumbnail(url);
        drive.dispatch->runUntilIdle();
    };
    writePicture(400, 200, 0x40);
    drive.writeDocument("Stuff/broken.pgm", "no picture");
    const auto list = shownList(drive.url("Stuff"));
    const HandLister::Entries entries{{"broken.pgm"}, {"photo.pgm"}, {"To", Kind::Link}};
    deliver(list, entries);
    EXPECT_TRUE(list->listView()->row(0).image->isNamed());
    EXPECT_EQ(list->listView()->row(2).image, Image::named("emblem-symbolic-link"));
    const auto first = *list->listView()->row(1).image;
    ASSERT_FALSE(first.isNamed());
    EXPECT_EQ(first.pixelWidth(), rowThumbnailSide);
    EXPECT_EQ(first.pixelHeight(), rowThumbnailSide / 2);
    EXPECT_EQ(first.pixels().front(), 0xff404040U);

    deliver(list, entries);
    EXPECT_EQ(list->listView()->row(1).image, first) << "not made again while nothing changed";

    writePicture(30, 60, 0x80);
    deliver(list, entries);
    const auto second = *list->listView()->row(1).image;
    EXPECT_EQ(second.pixelHeight(), 60);
    EXPECT_EQ(second.pixels().back(), 0xff808080U);
}

TEST_F(DocumentList, ReportsWhatIsTapped)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(
        list, {{"Trip", Kind::Folder}, {"Notes.txt"}, {"Letter.pages", Kind::Package}, {"To", Kind::Link}});
    EXPECT_EQ(delegate->take(), (Lines{"changed 4 selected 0"}));
    for (std::size_t row = 0; row < 5; ++row)
        list->listView()->activateRow(row);
    EXPECT_EQ(
        delegate->take(), (Lines{"folder Trip Trip", "item Notes.txt", "item Letter.pages", "item To"}));
}

TEST_F(DocumentList, OffersTheEnabledActionsWithTheirCodes)
{
    makePaintLibrary(drive);
    const auto list = shownList(*DocumentListController::createRootList()->presentedURL());
    deliver(list, {{"Notes.txt"}});
    delegate->take();
    EXPECT_TRUE(list->listView()->menuForRow(1).empty());

    list->setAvailableActions(125);
    for (const auto& entry : list->listView()->menuForRow(1))
        entry.handler();
    EXPECT_EQ(delegate->take(),
        (Lines{"action 2 Notes.txt", "action 4 Notes.txt", "action 3 Notes.txt", "action 5 Notes.txt",
            "action 0 Notes.txt"}));

    Lines titlesOfLibrary;
    for (const auto& entry : list->listView()->menuForRow(0))
        titlesOfLibrary.push_back(entry.title);
    EXPECT_EQ(titlesOfLibrary, (Lines{"Info", "Share", "Delete"}));
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
    deliver(list, {{"far.txt", Kind::Document, true}, {"here.txt"}});
    const auto row = [&] { return list->listView()->row(0); };
    const auto choose = [&](const std::string& title) {
        ASSERT_EQ(list->listView()->menuForRow(0).front().title, title);
        list->listView()->menuForRow(0).front().handler();
    };
    EXPECT_TRUE(list->listView()->menuForRow(1).empty());
    choose("Download");
    EXPECT_EQ(row().download, ui::DownloadState::Downloading);
    EXPECT_THAT(row().accessibleDescription, HasSubstr("Downloading"));
    choose("Cancel Download");
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(row().download, ui::DownloadState::InCloud);

    struct Shares : RecordingListObserver {
        void rowDidChange(ui::ListView& view, std::size_t index) override
        {
            shares.push_back(view.row(index).downloadProgress);
        }
        std::vector<double> shares;
    };
    const auto observer = std::make_shared<Shares>();
    list->listView()->setListObserver(observer);
    choose("Download");
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(observer->shares, testing::Contains(testing::AllOf(testing::Gt(0.2), testing::Lt(0.9))));
    EXPECT_TRUE(std::filesystem::exists(drive.url("Stuff/far.txt").path()));

    std::filesystem::remove(drive.url("Stuff/far.txt").path());
    far.content = "lost";
    drive.writePromise("Stuff/far.txt", far);
    choose("Download");
    drive.dispatch->runUntilIdle();
    EXPECT_TRUE(std::dynamic_pointer_cast<ui::AlertController>(list->presentedViewController()));
}

TEST_F(DocumentList, AnswersTheKeysOfItsRows)
{
    makePaintLibrary(drive);
    const auto list = shownList(*DocumentListController::createRootList()->presentedURL());
    deliver(list, {{"Notes.txt"}});
    list->setAvailableActions(125 & ~actionBit(DocumentListAction::Delete));
    delegate->take();
    const struct {
        std::size_t row;
        ui::RowCommand command;
        Lines told;
    } rows[] = {
        {1, ui::RowCommand::Rename, {"action 3 Notes.txt"}},
        {1, ui::RowCommand::Info, {"action 2 Notes.txt"}},
        {1, ui::RowCommand::Delete, {}}, // not enabled
        {1, ui::RowCommand::Peek, {}}, // nothing to show
        {0, ui::RowCommand::Rename, {}}, // not for a library
        {7, ui::RowCommand::Info, {}},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(list->listView()->commandRow(row.row, row.command), !row.told.empty());
        EXPECT_EQ(delegate->take(), row.told);
    }
}

TEST_F(DocumentList, AHeldRowShowsItsScreenWithWhatCanBeDoneWithIt)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a.txt"}, {"b.txt"}});
    list->setAvailableActions(125);
    delegate->take();
    delegate->preview = std::make_shared<ui::ViewController>();
    const auto peek = [&] {
        EXPECT_TRUE(list->listView()->commandRow(1, ui::RowCommand::Peek));
        drive.dispatch->runUntilIdle();
        return std::dynamic_pointer_cast<ui::AlertController>(list->presentedViewController());
    };
    auto shown = peek();
    ASSERT_TRUE(shown);
    EXPECT_EQ(shown->title(), "b.txt");
    shown->view();
    EXPECT_TRUE(delegate->preview->parent());
    shown->userCancelled();
    EXPECT_FALSE(list->presentedViewController());
    EXPECT_EQ(delegate->take(), Lines{});

    shown = peek();
    shown->view();
    shown->press(shown->preferredAction());
    EXPECT_EQ(delegate->take(), Lines{"action 6 b.txt"});
    EXPECT_FALSE(delegate->preview->parent());

    list->setAvailableActions(actionBit(DocumentListAction::Info));
    shown = peek();
    EXPECT_EQ(shown->actions().size(), 3U); // open, info, cancel
    shown->press(shown->preferredAction());
    EXPECT_EQ(delegate->take(), Lines{"item b.txt"});

    list->setEditingAnimated(true, false);
    EXPECT_FALSE(list->listView()->holdRow(1));
}

TEST_F(DocumentList, FindsRowsByWhatIsTypedInEveryScript)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    const HandLister::Entries entries{{"cafe.txt"}, {"Caf\u00e9 two"}, {"Cafe\u0301 three"},
        {"\u041e\u0442\u0447\u0451\u0442 1"}, {"\u041e\u0442\u0447\u0435\u0442 2"}, {"\u00c9"},
        {"\uff34\uff4f"}, {"no\xffutf8"}, {"x"}};
    deliver(list, entries);
    const struct {
        const char* typed;
        std::size_t from;
        std::optional<std::size_t> found;
    } rows[] = {
        {"caf", 0, 0},
        {"CAF\u00c9 T", 0, 1},
        {"cafe th", 0, 2},
        {"\u043e\u0442\u0447\u0435\u0442", 0, 3},
        {"\u041e\u0422\u0427\u0401\u0422 2", 0, 4},
        {"e", 0, 5},
        {"\u00e9", 6, 5}, // from the top again
        {"to", 0, 6},
        {"no", 0, 7},
        {"\u044f", 0, std::nullopt},
        {"xx", 0, std::nullopt},
    };
    for (const auto& row : rows)
        EXPECT_EQ(list->listView()->rowBeginningWith(row.typed, row.from), row.found) << row.typed;
}

TEST_F(DocumentList, SelectingByTheKeyboardAsksForEditMode)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}, {"b"}, {"c"}, {"d"}});
    delegate->take();
    list->listView()->selectAllByUser();
    EXPECT_EQ(list->selectedItemCount(), 0U);
    EXPECT_EQ(delegate->take(), Lines{"wants to select"});

    delegate->allowsEditing = true;
    list->listView()->extendSelectionTo(1);
    list->listView()->extendSelectionTo(3);
    EXPECT_EQ(list->selectedItemCount(), 3U);
    list->listView()->extendSelectionTo(0);
    EXPECT_EQ(list->selectedItems(), (std::vector{drive.url("Stuff/a"), drive.url("Stuff/b")}));
    list->selectAllItems();
    EXPECT_EQ(list->selectedItemCount(), 4U);
    list->deselectAllItems();
    EXPECT_EQ(list->selectedItemCount(), 0U);
}

TEST_F(DocumentList, SelectsWhileEditingAndKeepsTheSelectionThroughChanges)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    list->setAvailableActions(125);
    deliver(list, {{"a"}, {"b"}, {"c"}, {"d"}});
    list->setSelectedItems({drive.url("Stuff/a")});
    EXPECT_TRUE(list->selectedItems().empty());

    list->setEditingAnimated(true, true);
    delegate->take();
    list->listView()->activateRow(3);
    list->listView()->activateRow(1);
    EXPECT_EQ(delegate->take(), (Lines{"changed 4 selected 1", "changed 4 selected 2"}));
    EXPECT_TRUE(list->listView()->menuForRow(0).empty());

    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);
    deliver(list, {{"0"}, {"a"}, {"b"}, {"d"}});
    EXPECT_EQ(list->selectedItems(), (std::vector{drive.url("Stuff/b"), drive.url("Stuff/d")}));
    EXPECT_EQ(observer->last.splices, (std::vector<ui::ListSplice>{{0, 0, 1}, {3, 1, 0}}));
    EXPECT_EQ(observer->resets, 0);
    EXPECT_EQ(list->listView()->row(2).check, ui::CheckState::On);

    deliver(list, {{"a"}, {"b"}});
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/b")});
    list->setSelectedItems({drive.url("Stuff/a"), drive.url("Stuff/gone"), drive.url("Elsewhere/b")});
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/a")});
    list->setEditingAnimated(false, true);
    EXPECT_EQ(list->selectedItemCount(), 0U);
}

TEST_F(DocumentList, ReadsDetailsOfVisibleRowsOnly)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    const auto all = documents(10'000);
    lister->deliver(*list->presentedURL(), {all.begin(), all.begin() + 100}, ListingStage::FirstRows);
    EXPECT_EQ(list->containedItemCount(), 100U);
    deliver(list, all);
    EXPECT_EQ(list->containedItemCount(), 10'000U);
    const auto visible = list->listView()->visibleRows();
    EXPECT_LT(visible.count, 20U);
    // The first rows were wanted twice: when they came, and when the list was complete.
    EXPECT_LE(coordinator->takeReads().size(), 2 * visible.count);

    list->listView()->userScrolled({0, 5000 * list->listView()->rowHeight()});
    list->listView()->userScrolled({0, 9000 * list->listView()->rowHeight()});
    drive.dispatch->runUntilIdle();
    const auto read = coordinator->takeReads();
    ASSERT_FALSE(read.empty());
    EXPECT_LT(read.size(), 20U);
    for (const auto& name : read)
        EXPECT_GE(name, "item 109000.txt");
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

TEST_F(DocumentList, TakesTheNewestOfManyStates)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    // Each is large enough to be compared in the background, and comes before the one before is done.
    for (const auto count : {3000U, 5000U, 4000U})
        lister->deliver(*list->presentedURL(), documents(count));
    EXPECT_EQ(list->containedItemCount(), 0U);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(list->containedItemCount(), 4000U);
    EXPECT_EQ(list->listView()->rowCount(), 4000U);
    EXPECT_EQ(delegate->take(), (Lines{"changed 3000 selected 0", "changed 4000 selected 0"}));
}

TEST_F(DocumentList, SaysThatAFolderIsLoadingEmptyOrUnreadable)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    const auto& placeholder = *list->placeholder();
    EXPECT_TRUE(placeholder.isHidden());
    drive.dispatch->advance(1);
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_TRUE(placeholder.content().isBusy);

    deliver(list, {});
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_EQ(placeholder.content().title, "Folder is empty");
    deliver(list, {{"a"}});
    EXPECT_TRUE(placeholder.isHidden());

    lister->fail(*list->presentedURL(), Error(errorDomain::system, EACCES));
    EXPECT_FALSE(placeholder.isHidden());
    EXPECT_EQ(placeholder.content().title, "This folder cannot be shown");
    EXPECT_THAT(placeholder.content().message, HasSubstr("permission"));

    const auto quick = shownList(drive.makeFolder("Quick"));
    deliver(quick, {{"a"}});
    drive.dispatch->advance(1);
    EXPECT_TRUE(quick->placeholder()->isHidden());
}

TEST_F(DocumentList, ReportsARemovedFolderOnceAndOnlyWhileItIsShown)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}});
    list->beginAppearance(false, false);
    list->endAppearance();
    delegate->take();
    lister->fail(*list->presentedURL(), Error(FileErrorCode::NoSuchItem));
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(delegate->take(), (Lines{"changed 0 selected 0"}));

    list->beginAppearance(true, false);
    list->endAppearance();
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(delegate->take(), (Lines{"removed Stuff"}));
    lister->fail(*list->presentedURL(), Error(FileErrorCode::NoSuchItem));
    EXPECT_EQ(delegate->take(), (Lines{"changed 0 selected 0"}));
}

TEST_F(DocumentList, ShowsItsItemsInTheChosenOrder)
{
    using Direction = OrderDirection;
    const auto setTime = [&](const char* name, int seconds) {
        const std::filesystem::file_time_type time{std::chrono::seconds(seconds)};
        std::filesystem::last_write_time(drive.url(name).path(), time);
    };
    drive.writeDocument("Stuff/a.txt", "12345");
    drive.writeDocument("Stuff/b.pdf", "1");
    drive.writeDocument("Stuff/c.txt", "123");
    drive.makeFolder("Stuff/Z");
    host::drive::PromiseRecord far;
    far.size = 4;
    drive.writePromise("Stuff/far.txt", far);
    setTime("Stuff/a.txt", 10);
    setTime("Stuff/b.pdf", 30);
    setTime("Stuff/c.txt", 20);
    const struct {
        ListOrder order;
        Lines titles;
    } rows[] = {
        {{OrderKey::Name, Direction::Descending}, {"Z", "far.txt", "c.txt", "b.pdf", "a.txt"}},
        {{OrderKey::Date, Direction::Descending}, {"Z", "b.pdf", "c.txt", "a.txt", "far.txt"}},
        {{OrderKey::Date, Direction::Ascending}, {"Z", "far.txt", "a.txt", "c.txt", "b.pdf"}},
        {{OrderKey::Size, Direction::Descending}, {"Z", "a.txt", "far.txt", "c.txt", "b.pdf"}},
        {{OrderKey::Kind, Direction::Ascending}, {"Z", "b.pdf", "a.txt", "c.txt", "far.txt"}},
        {{OrderKey::Name, Direction::Ascending}, {"Z", "a.txt", "b.pdf", "c.txt", "far.txt"}},
    };
    const HandLister::Entries entries{
        {"Z", Kind::Folder}, {"a.txt"}, {"b.pdf"}, {"c.txt"}, {"far.txt", Kind::Document, true}};
    const auto list = shownList(drive.url("Stuff"));
    deliver(list, entries);
    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("Stuff/c.txt")});
    const auto observer = std::make_shared<RecordingListObserver>();
    list->listView()->setListObserver(observer);
    for (const auto& row : rows) {
        list->setOrder(row.order);
        deliver(list, entries);
        EXPECT_EQ(std::exchange(observer->resets, 0), 1) << "another order is another list";
        EXPECT_EQ(titles(list), row.titles);
        EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/c.txt")});
        EXPECT_EQ(shownList(drive.url("Stuff"))->order(), row.order) << "kept for the folder";
    }
    list->setOrder({OrderKey::Name, Direction::Ascending, FolderGrouping::Mixed});
    EXPECT_EQ(lister->grouping(), FolderGrouping::Mixed);
    EXPECT_EQ(shownList(drive.makeFolder("Other"))->order(), ListOrder());
}

TEST_F(DocumentList, OffersTheOrdersInAMenu)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}, {"b"}});
    const auto choose = [&](const std::string& title) {
        for (const auto& entry : list->listView()->menuForList()) {
            if (entry.title == title)
                entry.handler();
        }
    };
    const auto marked = [&] {
        Lines titles;
        for (const auto& entry : list->navigationItem().menu()())
            if (entry.mark == ui::MenuMark::On)
                titles.push_back(entry.title);
        return titles;
    };
    EXPECT_EQ(marked(), (Lines{"Name", "Ascending", "Folders First"}));
    choose("Size");
    EXPECT_EQ(marked(), (Lines{"Size", "Descending", "Folders First"}));
    choose("Ascending");
    choose("Folders First");
    EXPECT_EQ(marked(), (Lines{"Size", "Ascending"}));
    list->setEditingAnimated(true, false);
    deliver(list, {{"a"}, {"b"}});
    choose("Select All");
    EXPECT_EQ(list->selectedItemCount(), 2U);
    choose("Select None");
    EXPECT_EQ(list->selectedItemCount(), 0U);
}

TEST_F(DocumentList, ListsAnewWhenItIsPulled)
{
    const auto list = shownList(drive.makeFolder("Stuff"));
    deliver(list, {{"a"}});
    list->listView()->pulledToRefresh();
    EXPECT_TRUE(list->listView()->isRefreshing());
    EXPECT_EQ(lister->listingsStarted(), 2U);
    deliver(list, {{"a"}, {"b"}});
    EXPECT_FALSE(list->listView()->isRefreshing());
    EXPECT_EQ(titles(list), (Lines{"a", "b"}));
}

TEST_F(DocumentList, KnowsTheWayFromTheTopOfTheDrive)
{
    const auto library = makePaintLibrary(drive);
    const struct {
        Url url;
        Lines names;
    } rows[] = {
        {drive.url("Documents/Trip"), {"Tarrow Drive", "Documents", "Trip"}},
        {library, {"Tarrow Drive", "Paint"}},
        {library.appendingPathComponent("Sketches"), {"Tarrow Drive", "Paint", "Sketches"}},
        {Url::fileURL("/tmp"), {}},
        {Url::fileURL(drive.layout().trash()), {}},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.url.path());
        Lines names;
        for (const auto& list : DocumentListController::hierarchyForURL(row.url))
            names.push_back(list->title());
        if (!names.empty())
            names.front() = "Tarrow Drive";
        EXPECT_EQ(names, row.names);
    }
}

TEST_F(DocumentList, SearchesTheWholeDriveAndSaysWhereItemsLie)
{
    drive.writeDocument("Stuff/Spain/My trip.txt");
    drive.makeFolder("Stuff/Trip");
    drive.writeDocument("trip plan.txt");
    const auto list = shownList(drive.url("Stuff"));
    list->startSearchWithQueryStringBecomeFirstResponder("TRIP", true);
    drive.dispatch->runUntilIdle();
    const auto search = std::dynamic_pointer_cast<ui::SearchPresentation>(list->presentedViewController());
    ASSERT_TRUE(search);
    EXPECT_TRUE(search->hasFocus());
    const auto results = std::dynamic_pointer_cast<ui::ListView>(search->view()->subviews().front());
    ASSERT_TRUE(results);
    results->setFrame({0, 0, 360, 600});
    results->layoutIfNeeded();
    drive.dispatch->runUntilIdle();
    std::map<std::string, std::string> places;
    for (std::size_t row = 0; row < results->rowCount(); ++row)
        places[results->row(row).title] = results->row(row).detail;
    EXPECT_THAT(places,
        testing::ElementsAre(testing::Pair("My trip.txt", testing::StartsWith("Stuff › Spain · ")),
            testing::Pair("Trip", testing::StartsWith("Stuff · ")),
            testing::Pair("trip plan.txt", testing::StartsWith(folderTitle(drive.url(""))))));

    search->userEditedQuery("my");
    drive.dispatch->runUntilIdle();
    ASSERT_EQ(results->rowCount(), 1U);
    delegate->take();
    results->activateRow(0);
    results->menuForRow(0).front().handler();
    EXPECT_EQ(delegate->take(), (Lines{"item My trip.txt", "folder Spain Spain"}));
    search->userEditedQuery("");
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(results->rowCount(), 0U);
}

TEST_F(DocumentList, FollowsTheFolderOnDisk)
{
    useRealLister();
    drive.writeDocument("Stuff/b.txt");
    drive.writeDocument("Stuff/a10.txt");
    drive.writeDocument("Stuff/a9.txt");
    drive.makeFolder("Stuff/Trip");
    drive.writePromise("Stuff/far.txt", {});
    const auto list = shownList(drive.url("Stuff"));
    ASSERT_TRUE(waitUntil([&] { return list->containedItemCount() == 5; }));
    EXPECT_EQ(titles(list), (Lines{"Trip", "a9.txt", "a10.txt", "b.txt", "far.txt"}));

    list->setEditingAnimated(true, false);
    list->setSelectedItems({drive.url("Stuff/b.txt")});
    drive.writeDocument("Stuff/a11.txt");
    std::filesystem::remove(drive.url("Stuff/a9.txt").path());
    ASSERT_TRUE(waitUntil([&] { return titles(list).at(2) == "a11.txt"; }));
    EXPECT_EQ(list->selectedItems(), std::vector{drive.url("Stuff/b.txt")});

    delegate->take();
    std::filesystem::remove_all(drive.url("Stuff").path());
    ASSERT_TRUE(waitUntil([&] { return list->containedItemCount() == 0; }));
    drive.dispatch->runUntilIdle();
    EXPECT_THAT(delegate->take(), testing::Contains("removed Stuff"));
}

TEST_F(DocumentList, SaysWhyAFolderOnDiskCannotBeRead)
{
    useRealLister();
    const auto list = shownList(drive.writeDocument("Stuff", "no folder"));
    ASSERT_TRUE(waitUntil([&] { return !list->placeholder()->content().title.empty(); }));
    EXPECT_EQ(list->placeholder()->content().title, "This folder cannot be shown");
    EXPECT_FALSE(list->placeholder()->content().message.empty());
}

struct ListWithoutSearch : DocumentListController {
    using DocumentListController::DocumentListController;
    bool shouldShowSearch() const override { return false; }
};

TEST_F(DocumentList, OffersASearchFieldUnlessItShouldNot)
{
    const auto plain = shownList(drive.makeFolder("Stuff"));
    EXPECT_TRUE(plain->navigationItem().searchAction());
    const auto without = std::make_shared<ListWithoutSearch>(std::nullopt);
    without->view();
    EXPECT_FALSE(without->navigationItem().searchAction());
    EXPECT_TRUE(without->containedItems().empty());
}

TEST_F(DocumentList, TellsWhoIsNotSignedInWhatToDo)
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
