// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ContainerRecord.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/views/Button.h"
#include "kit/views/ListView.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"
#include "tests/support/RecordingSharing.h"

namespace tarrow {
namespace {

using namespace testing_support;
using platform::Notification;
using platform::Url;
using testing::ElementsAre;
using testing::IsEmpty;

class AddingTest : public BrowserFixture {
protected:
    AddingTest() { drive.makeFolder("Trip"); }
    /// Presses "Add Files…" in the list's menu. The answer chooses files.
    RecordingSharing::Chosen press() const
    {
        for (const auto& entry : topList()->listView()->menuForList()) {
            if (entry.title == "Add Files…")
                entry.handler();
        }
        auto& sharing = dynamic_cast<RecordingSharing&>(platform::services().documentSharing());
        return std::exchange(sharing.asked, nullptr);
    }
    void add(const std::vector<Url>& items)
    {
        browser->addItems(items);
        settle();
    }
    Url outside(const std::string& name, std::string_view content = "content") const
    {
        return writeFile(drive.folder().at("outside/" + name), content);
    }
    bool isThere(std::string_view path) const { return std::filesystem::exists(url(path).path()); }
};

TEST_F(AddingTest, ChosenFilesAreCopiedToldAndCanBeTakenBack)
{
    write("Trip/plan.pdf", "old");
    launch();
    ASSERT_TRUE(warp("Trip"));
    press()({outside("plan.pdf", "new"), outside("a.txt"), outside("b.txt")});
    settle();
    EXPECT_THAT(takeNotices(), ElementsAre("3 items were added to “Trip”"));
    EXPECT_EQ(contentOf(url("Trip/plan.pdf").path()), "old");
    EXPECT_EQ(contentOf(url("Trip/plan 2.pdf").path()), "new");
    EXPECT_TRUE(isThere("Trip/a.txt"));
    write("Trip/a.txt", "edited meanwhile");
    EXPECT_TRUE(window->undoRequested());
    settle();
    EXPECT_FALSE(isThere("Trip/plan 2.pdf") || isThere("Trip/b.txt"));
    EXPECT_TRUE(isThere("Trip/a.txt"));
    EXPECT_EQ(takeAlert(), "“a.txt” wasn’t moved, because another program has changed it.");
    EXPECT_EQ(platform::services().trash().items()->size(), 2U) << "nothing is deleted for good";
    EXPECT_TRUE(std::filesystem::exists(drive.folder().at("outside/a.txt")));
}

TEST_F(AddingTest, AnEmptyFolderOffersItToo)
{
    launch();
    ASSERT_TRUE(warp("Trip"));
    const auto& buttons = topList()->placeholder()->buttons();
    ASSERT_EQ(buttons.size(), 2U);
    EXPECT_EQ(buttons.back()->title(), "Add Files…");
    press()({});
    settle();
    EXPECT_THAT(takeNotices(), IsEmpty()) << "the user thought better of it";
    press()({outside("a.txt")});
    settle();
    EXPECT_THAT(takeNotices(), ElementsAre("“a.txt” was added to “Trip”"));
}

TEST_F(AddingTest, WhatIsDroppedOrPastedIsAddedWhereAListIsShown)
{
    write("a.txt");
    launch();
    ASSERT_TRUE(warp("Trip"));
    outside("Photos/far/b.txt");
    EXPECT_TRUE(window->takesFiles());
    EXPECT_TRUE(window->filesOffered({Url::fileURL(drive.folder().at("outside/Photos")), url("a.txt")}));
    settle();
    EXPECT_TRUE(isThere("Trip/Photos/far/b.txt") && isThere("Trip/a.txt") && isThere("a.txt"));
    browser->promtForNewFolderAndCreate(nullptr);
    EXPECT_FALSE(window->takesFiles()) << "a question lies over the list";
    EXPECT_FALSE(window->filesOffered({url("a.txt")}));
    alert()->press(0);
    settle();
    ASSERT_TRUE(warp("a.txt", PreviewModeDetails));
    EXPECT_FALSE(window->takesFiles());
}

TEST_F(AddingTest, AContainerWithoutFoldersTakesFilesAndPackages)
{
    host::drive::ContainerRecord description;
    description.supportedFolderLevels = platform::folderLevels::none;
    const auto documents = drive.makeContainer("Flat", description);
    launch();
    outside("Photos/a.txt");
    outside("Note.textbundle/text.md");
    ASSERT_TRUE(browser->warpToFolderForURL(documents));
    settle();
    const auto from = [&](const char* name) { return Url::fileURL(drive.folder().at(name)); };
    add({from("outside/Photos"), from("outside/Note.textbundle"), outside("b.txt")});
    EXPECT_THAT(takeAlert(), testing::StartsWith("“Photos” wasn’t added, because “"));
    EXPECT_TRUE(std::filesystem::exists(documents.path() + "/Note.textbundle/text.md"));
    EXPECT_TRUE(std::filesystem::exists(documents.path() + "/b.txt"));
    EXPECT_FALSE(std::filesystem::exists(documents.path() + "/Photos"));
}

TEST_F(AddingTest, WhatIsHereIsCopiedForOtherPrograms)
{
    write("a.txt"), write("Trip/b.txt");
    drive.makeFolder("Far");
    drive.writePromise("Far/c.pdf", {});
    drive.writePromise("d.pdf", {});
    launch();
    auto& sharing = dynamic_cast<RecordingSharing&>(platform::services().documentSharing());
    const auto copy = [&](const std::vector<Url>& items) {
        browser->copyItems(items);
        settle();
        return std::exchange(sharing.lines, {});
    };
    EXPECT_THAT(copy({url("a.txt")}), ElementsAre("copy file a.txt"));
    EXPECT_THAT(copy({url("a.txt"), url("Trip")}), ElementsAre("copy file a.txt", "copy file Trip"));
    EXPECT_THAT(takeNotices(), ElementsAre("“a.txt” was copied", "2 items were copied"));
    EXPECT_THAT(copy({url("a.txt"), url("Far")}), IsEmpty());
    EXPECT_EQ(takeAlert(), "“c.pdf” is still in the cloud, so it can’t be copied. Download it first.");
    EXPECT_THAT(copy({url("d.pdf"), url("Far")}), IsEmpty());
    EXPECT_EQ(takeAlert(), "2 documents are still in the cloud and can’t be copied. Download them first.");
    EXPECT_THAT(takeNotices(), IsEmpty());
}

TEST_F(AddingTest, SaysWhatCouldNotBeAdded)
{
    launch();
    ASSERT_TRUE(warp("Trip"));
    add({Url::fileURL(drive.folder().at("outside/gone.txt")), outside("a.txt")});
    EXPECT_EQ(takeAlert(), "“gone.txt” is no longer there.");
    EXPECT_TRUE(isThere("Trip/a.txt"));
    add({url("Trip")});
    EXPECT_EQ(takeAlert(), "“Trip” can’t be added to itself.");
    takeNotices();

    int waits = 0;
    coordinator->whileWaiting = [&] {
        if (++waits == 2)
            cloud->token.reset();
    };
    add({outside("b.txt"), outside("c.txt")});
    coordinator->whileWaiting = {};
    EXPECT_TRUE(isThere("Trip/b.txt"));
    EXPECT_FALSE(isThere("Trip/c.txt")) << "who asked has signed out";
}

TEST_F(AddingTest, FilesThatWereAskedForByAnotherUserAreNotAdded)
{
    launch();
    ASSERT_TRUE(warp("Trip"));
    const auto chosen = press();
    cloud->token.reset();
    post(Notification::CloudIdentityDidChange);
    cloud->token = platform::PropertyValue("account-2");
    post(Notification::CloudIdentityDidChange);
    settle();
    chosen({outside("a.txt")});
    settle();
    EXPECT_FALSE(isThere("Trip/a.txt"));
}

} // namespace
} // namespace tarrow
