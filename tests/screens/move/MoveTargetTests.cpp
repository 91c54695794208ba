// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/ScreensFixture.h"

#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "kit/views/ViewObserver.h"
#include "platform/FileSystem.h"
#include "screens/PlaceholderView.h"
#include "screens/move/MoveTargetPicker.h"
#include "screens/move/MoveTargetScreen.h"

using namespace platform;
using namespace screens;
using namespace testing;
using testing_support::Lines;
using testing_support::ScreensFixture;

namespace {

using Kind = FolderEntryKind;

struct RecordingPickerDelegate : MoveTargetPickerDelegate {
    void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<MoveTargetPicker>&, const Url& folder) override
    {
        lines.push_back("to " + folder.lastPathComponent());
    }
    void documentTargetSelectionControllerWasCancelled(const std::shared_ptr<MoveTargetPicker>&) override
    {
        lines.emplace_back("cancelled");
    }
    Lines lines;
};

class MoveTarget : public ScreensFixture {
protected:
    std::shared_ptr<MoveTargetPicker> pick(
        std::vector<Url> items, MoveTargetScope scope = MoveTargetScope::Container)
    {
        auto picker = MoveTargetPicker::initWithItemsScope(std::move(items), scope);
        picker->setDelegate(told);
        base->presentViewController(picker, false);
        load(*picker);
        return picker;
    }
    /// Shows the top screen with a listing, and waits until it has read the disk.
    std::shared_ptr<MoveTargetScreen> load(
        const MoveTargetPicker& picker, const testing_support::HandLister::Entries& entries = {})
    {
        auto screen = std::static_pointer_cast<MoveTargetScreen>(picker.topViewController());
        screen->view()->setFrame({0, 0, 360, 600});
        screen->view()->layoutIfNeeded();
        drive.settle();
        lister->deliver(screen->folder(), entries);
        drive.dispatch->runUntilIdle();
        return screen;
    }
    static std::string folderOf(const MoveTargetPicker& picker)
    {
        const auto screen = std::static_pointer_cast<MoveTargetScreen>(picker.topViewController());
        return screen->folder().lastPathComponent();
    }

    std::shared_ptr<kit::ViewController> base = std::make_shared<kit::ViewController>();
    std::shared_ptr<RecordingPickerDelegate> told = std::make_shared<RecordingPickerDelegate>();
};

TEST_F(MoveTarget, DimsFoldersThatAreToBeMovedAndDoesNotEnterThem)
{
    const auto moved = drive.makeFolder("Trips/Italy");
    const auto picker = pick({moved});
    const auto screen = load(*picker, {{"Italy", Kind::Folder}, {"Spain", Kind::Folder}});
    EXPECT_TRUE(screen->listView()->row(0).isDimmed);
    EXPECT_FALSE(screen->listView()->row(1).isDimmed);
    screen->listView()->activateRow(0);
    EXPECT_EQ(folderOf(*picker), "Trips");
    screen->listView()->activateRow(1);
    EXPECT_EQ(folderOf(*picker), "Spain");
}

TEST_F(MoveTarget, TakesTheKeyboardFromTheListUnderIt)
{
    struct Focus : kit::ViewObserver {
        void viewDidChange(kit::View&, kit::ViewChanges) override { }
        void viewWantsFocus(kit::View&, bool focus) override { taken += focus ? 1 : 0; }
        int taken = 0;
    };
    const auto focus = std::make_shared<Focus>();
    const auto picker = pick({drive.writeDocument("Notes.txt")});
    const auto screen = load(*picker);
    screen->listView()->setObserver(focus);
    screen->beginAppearance(true, false);
    screen->endAppearance();
    EXPECT_EQ(focus->taken, 0) << "there is no row yet";
    load(*picker, {{"Stuff", Kind::Folder}});
    load(*picker, {{"Other", Kind::Folder}, {"Stuff", Kind::Folder}});
    EXPECT_EQ(focus->taken, 1);
}

TEST_F(MoveTarget, LeadsToOtherContainersOnlyWhereTheMoveMay)
{
    const auto library = drive.makeContainer("com.example.paint");
    const auto inDrive = drive.writeDocument("Notes.txt");
    const auto inLibrary = library.appendingPathComponent("Sketch.txt");

    const auto plain = pick({inDrive});
    auto screen = load(*plain, {{"Stuff", Kind::Folder}});
    EXPECT_THAT(titles(*screen->listView()), ElementsAre("Stuff"));
    EXPECT_FALSE(plain->offers(library));
    plain->cancel();

    const auto crossing = pick({inDrive}, MoveTargetScope::AllContainers);
    screen = load(*crossing, {{"Stuff", Kind::Folder}});
    EXPECT_EQ(titles(*screen->listView()).size(), 2U);
    EXPECT_TRUE(crossing->offers(library));
    crossing->cancel();

    const auto within = pick({inLibrary});
    EXPECT_EQ(within->viewControllers().size(), 1U);
    EXPECT_FALSE(within->offers(drive.url("Stuff")));
    EXPECT_THAT(told->lines, ElementsAre("cancelled", "cancelled"));
}

TEST_F(MoveTarget, OffersTheLastDestinationsThatAreStillThere)
{
    const auto item = drive.writeDocument("Notes.txt");
    const auto kept = drive.makeFolder("Archive/2025");
    const auto first = pick({item});
    first->choose(kept);
    first->choose(kept);
    first->dismissViewController(false);
    const auto second = pick({item});
    second->choose(drive.url("Vanished"));
    second->dismissViewController(false);
    EXPECT_THAT(told->lines, ElementsAre("to 2025", "to Vanished"));

    const auto third = pick({item});
    const auto screen = load(*third, {{"Stuff", Kind::Folder}});
    EXPECT_THAT(titles(*screen->listView()), ElementsAre("Recent", "2025", "Folders", "Stuff"));
    screen->listView()->activateRow(1);
    EXPECT_EQ(folderOf(*third), "2025");
    EXPECT_TRUE(load(*third)->toolbarItems().back()->isEnabled());
}

TEST_F(MoveTarget, CanBeLeftWhenWhatWasToBeMovedIsGone)
{
    const auto folder = drive.makeFolder("Archive");
    const auto picker = pick({drive.writeDocument("Notes.txt")});
    told = nullptr;
    picker->choose(folder);
    EXPECT_FALSE(base->presentedViewController());

    const auto outside = pick({Url::fileURL(drive.folder().at("gone library/Sketch.txt"))});
    ASSERT_THAT(outside->viewControllers(), SizeIs(1));
    outside->topViewController()->navigationItem().rightItems().front()->press();
    EXPECT_FALSE(base->presentedViewController());
}

TEST_F(MoveTarget, MakesAFolderAndEntersItOrSaysWhyNot)
{
    const auto picker = pick({drive.writeDocument("Notes.txt")});
    const auto screen = load(*picker);
    const auto ask = [&](const std::string& name) {
        screen->askForNewFolder();
        const auto alert = alertOver(*picker);
        alert->textFields().front()->userEdited(name, {});
        const bool pressed = alert->press(1);
        if (!pressed)
            alert->userCancelled();
        drive.settle();
        return pressed;
    };
    for (const auto* refused : {"", "   ", ".hidden", "a/b", "a:b"})
        EXPECT_FALSE(ask(refused)) << refused;
    drive.writeDocument("Taken");
    EXPECT_TRUE(ask("Taken"));
    const auto failure = alertOver(*picker);
    ASSERT_TRUE(failure);
    EXPECT_FALSE(failure->message().empty());
    failure->press(std::size_t{0});
    EXPECT_TRUE(ask("  Fresh  "));
    EXPECT_EQ(folderOf(*picker), "Fresh");
    EXPECT_EQ(services().fileSystem().typeOfItem(drive.url("Fresh").path()), FileType::Directory);
}

TEST_F(MoveTarget, SaysWhenThereAreNoFoldersAndWhenTheFolderIsGone)
{
    const auto picker = pick({drive.writeDocument("Stuff/Notes.txt")});
    const auto screen = load(*picker, {{"Notes.txt"}, {"Deck.key", Kind::Package}});
    EXPECT_FALSE(screen->placeholder()->isHidden());
    EXPECT_EQ(screen->placeholder()->content().title, localized("No folders here"));
    lister->fail(screen->folder(), Error(FileErrorCode::NoSuchItem));
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(screen->placeholder()->content().title, localized("This folder cannot be shown"));
    EXPECT_FALSE(screen->toolbarItems().back()->isEnabled());
}

} // namespace
