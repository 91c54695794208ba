// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/ComponentsFixture.h"

#include "host/drive/records/ContainerRecord.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "platform/FileSystem.h"
#include "screens/PlaceholderView.h"
#include "screens/move/MoveTargetPicker.h"
#include "screens/move/MoveTargetScreen.h"

using namespace platform;
using namespace screens;
using namespace testing;
using testing_support::ComponentsFixture;

namespace {

using Kind = FolderEntryKind;
using Lines = std::vector<std::string>;

struct RecordingPickerDelegate : MoveTargetPickerDelegate {
    void documentTargetSelectionControllerDidSelectItemAtURL(
        const std::shared_ptr<MoveTargetPicker>&, const Url& folder) override
    {
        lines.push_back("to " + folder.lastPathComponent());
    }
    void documentTargetSelectionControllerWasCancelled(const std::shared_ptr<MoveTargetPicker>&) override
    {
        lines.push_back("cancelled");
    }
    Lines lines;
};

class MoveTarget : public ComponentsFixture {
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
    /// Shows the top screen, and waits until it has read the disk.
    std::shared_ptr<MoveTargetScreen> load(const MoveTargetPicker& picker)
    {
        auto screen = std::static_pointer_cast<MoveTargetScreen>(picker.topViewController());
        screen->view()->setFrame({0, 0, 360, 600});
        screen->view()->layoutIfNeeded();
        drive.settle();
        return screen;
    }
    static Lines stack(const MoveTargetPicker& picker)
    {
        Lines names;
        for (const auto& screen : picker.viewControllers())
            names.push_back(std::static_pointer_cast<MoveTargetScreen>(screen)->folder().lastPathComponent());
        return names;
    }
    static Lines rows(const MoveTargetScreen& screen)
    {
        Lines titles;
        for (std::size_t row = 0; row < screen.listView()->rowCount(); ++row)
            titles.push_back(screen.listView()->row(row).title);
        return titles;
    }
    void show(const MoveTargetScreen& screen, const testing_support::HandLister::Entries& entries)
    {
        lister->deliver(screen.folder(), entries);
        drive.dispatch->runUntilIdle();
    }
    static std::shared_ptr<kit::BarButtonItem> moveButton(const MoveTargetScreen& screen)
    {
        return screen.toolbarItems().back();
    }

    std::shared_ptr<kit::ViewController> base = std::make_shared<kit::ViewController>();
    std::shared_ptr<RecordingPickerDelegate> told = std::make_shared<RecordingPickerDelegate>();
};

TEST_F(MoveTarget, StartsWhereTheItemsAreAndLetsOnlyOtherFoldersBeChosen)
{
    const auto item = drive.writeDocument("Trips/Italy/plan.txt");
    drive.makeFolder("Trips/Italy/Rome");
    const auto picker = pick({item});
    EXPECT_THAT(stack(*picker), testing::Contains("Italy"));
    EXPECT_EQ(stack(*picker).back(), "Italy");
    auto screen = load(*picker);
    show(*screen, {{"Rome", Kind::Folder}, {"plan.txt"}, {"Deck.key", Kind::Package}});
    EXPECT_THAT(rows(*screen), ElementsAre("Rome"));
    EXPECT_FALSE(moveButton(*screen)->press());

    screen->listView()->activateRow(0);
    screen = load(*picker);
    EXPECT_TRUE(moveButton(*screen)->press());
    moveButton(*screen)->press();
    EXPECT_THAT(told->lines, ElementsAre("to Rome"));
}

TEST_F(MoveTarget, DimsFoldersThatAreToBeMovedAndDoesNotEnterThem)
{
    const auto moved = drive.makeFolder("Trips/Italy");
    const auto picker = pick({moved});
    const auto screen = load(*picker);
    show(*screen, {{"Italy", Kind::Folder}, {"Spain", Kind::Folder}});
    EXPECT_TRUE(screen->listView()->row(0).isDimmed);
    EXPECT_FALSE(screen->listView()->row(1).isDimmed);
    screen->listView()->activateRow(0);
    EXPECT_EQ(stack(*picker).back(), "Trips");
    screen->listView()->activateRow(1);
    EXPECT_EQ(stack(*picker).back(), "Spain");
}

TEST_F(MoveTarget, LeadsToOtherContainersOnlyWhereTheMoveMay)
{
    const auto library = drive.makeContainer("com.example.paint");
    const auto inDrive = drive.writeDocument("Notes.txt");
    const auto inLibrary = library.appendingPathComponent("Sketch.txt");

    const auto plain = pick({inDrive});
    auto screen = load(*plain);
    show(*screen, {{"Stuff", Kind::Folder}});
    EXPECT_THAT(rows(*screen), ElementsAre("Stuff"));
    EXPECT_FALSE(plain->offers(library));
    plain->cancel();

    const auto crossing = pick({inDrive}, MoveTargetScope::AllContainers);
    screen = load(*crossing);
    show(*screen, {{"Stuff", Kind::Folder}});
    EXPECT_EQ(rows(*screen).size(), 2U);
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
    const auto screen = load(*third);
    show(*screen, {{"Stuff", Kind::Folder}});
    EXPECT_THAT(rows(*screen), ElementsAre("Recent", "2025", "Folders", "Stuff"));
    screen->listView()->activateRow(1);
    EXPECT_EQ(stack(*third).back(), "2025");
    EXPECT_TRUE(moveButton(*load(*third))->isEnabled());
}

TEST_F(MoveTarget, MakesAFolderAndEntersItOrSaysWhyNot)
{
    const auto picker = pick({drive.writeDocument("Notes.txt")});
    const auto screen = load(*picker);
    const auto ask = [&](const std::string& name) {
        screen->askForNewFolder();
        const auto alert = std::static_pointer_cast<kit::AlertController>(picker->presentedViewController());
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
    const auto failure = std::static_pointer_cast<kit::AlertController>(picker->presentedViewController());
    ASSERT_TRUE(failure);
    EXPECT_FALSE(failure->message().empty());
    failure->press(std::size_t{0});
    EXPECT_TRUE(ask("  Fresh  "));
    EXPECT_EQ(stack(*picker).back(), "Fresh");
    EXPECT_EQ(services().fileSystem().typeOfItem(drive.url("Fresh").path()), FileType::Directory);
}

TEST_F(MoveTarget, SaysWhenThereAreNoFoldersAndWhenTheFolderIsGone)
{
    const auto picker = pick({drive.writeDocument("Stuff/Notes.txt")});
    const auto screen = load(*picker);
    show(*screen, {{"Notes.txt"}});
    EXPECT_FALSE(screen->placeholder()->isHidden());
    EXPECT_EQ(screen->placeholder()->content().title, localized("No folders here"));
    lister->fail(screen->folder(), Error(FileErrorCode::NoSuchItem));
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(screen->placeholder()->content().title, localized("This folder cannot be shown"));
    EXPECT_FALSE(moveButton(*screen)->isEnabled());
}

} // namespace
