// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/DownloadsScreen.h"
#include "items/FileUtils.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "screens/PlaceholderView.h"
#include "screens/list/DocumentListController.h"
#include "tests/browser/support/BrowserFixture.h"

namespace tarrow {
namespace {

using namespace testing_support;
using testing::ElementsAre;
using testing::IsEmpty;

class DownloadTest : public BrowserFixture {
protected:
    /// Answers the titles of a row's entries about downloads.
    std::vector<std::string> offered(const std::string& name)
    {
        std::vector<std::string> titles;
        for (const auto& entry : menuOf(name)) {
            if (entry.title.find("Download") != std::string::npos)
                titles.push_back(entry.title);
        }
        return titles;
    }
    kit::Menu menuOf(const std::string& name)
    {
        const auto& list = *topList()->listView();
        for (std::size_t row = 0; row < list.rowCount(); ++row) {
            if (list.row(row).title == name)
                return topList()->listView()->menuForRow(row);
        }
        return {};
    }
    void choose(const kit::Menu& menu, const std::string& title)
    {
        for (const auto& entry : menu) {
            if (entry.title == title)
                entry.handler();
        }
        settle();
        settle(); // the list hears of the change, and reads it a little later
        dispatch->advance(1);
    }
    bool isHere(std::string_view path) const { return std::filesystem::exists(url(path).path()); }
};

TEST_F(DownloadTest, DownloadsAreRemovedAndComeBack)
{
    write("Trip/a.txt", "a"), write("Trip/sub/b.txt", "b"), write("c.txt", "c");
    launch();
    EXPECT_THAT(offered("c.txt"), ElementsAre("Remove Download"));
    EXPECT_THAT(offered("Trip"), ElementsAre("Download", "Remove Download"));
    choose(menuOf("Trip"), "Remove Download");
    EXPECT_THAT(takeNotices(), ElementsAre("2 downloads were removed"));
    EXPECT_FALSE(isHere("Trip/a.txt") || isHere("Trip/sub/b.txt"));
    choose(menuOf("Trip"), "Remove Download");
    EXPECT_THAT(takeNotices(), ElementsAre("There is no download to remove"));
    choose(menuOf("Trip"), "Download");
    EXPECT_EQ(contentOf(url("Trip/a.txt")), "a");
    EXPECT_EQ(contentOf(url("Trip/sub/b.txt")), "b");
    choose(menuOf("Trip"), "Download");
    EXPECT_THAT(takeNotices(), ElementsAre("Everything is downloaded already"));

    browser->beginEditMode(nullptr);
    topList()->setSelectedItems({url("c.txt"), url("Trip")});
    choose(topList()->optionsMenu(), "Remove Download");
    EXPECT_THAT(takeNotices(), ElementsAre("3 downloads were removed"));
    browser->endEditMode(nullptr);
    EXPECT_THAT(offered("c.txt"), ElementsAre("Download"));
    choose(menuOf("c.txt"), "Download");
    EXPECT_EQ(contentOf(url("c.txt")), "c");
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(DownloadTest, APackageIsOneDocument)
{
    write("Trip/Notes.textbundle/text.md", "text"), write("Own.textbundle/text.md", "own");
    write("Trip/a.txt", "a");
    launch();
    EXPECT_THAT(offered("Own.textbundle"), ElementsAre("Remove Download"));
    browser->beginEditMode(nullptr);
    topList()->setSelectedItems({url("Own.textbundle"), url("Trip")});
    choose(topList()->optionsMenu(), "Remove Download");
    EXPECT_THAT(takeNotices(), ElementsAre("3 downloads were removed"));
    EXPECT_FALSE(isHere("Own.textbundle") || isHere("Trip/Notes.textbundle"));
    choose(topList()->optionsMenu(), "Download");
    EXPECT_EQ(contentOf(url("Own.textbundle/text.md")), "own");
    EXPECT_EQ(contentOf(url("Trip/Notes.textbundle/text.md")), "text");
    browser->endEditMode(nullptr);
    choose(menuOf("Own.textbundle"), "Remove Download");
    EXPECT_THAT(offered("Own.textbundle"), ElementsAre("Download"));
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(DownloadTest, AFolderInTheCloudIsDownloadedByATap)
{
    host::drive::PromiseRecord folder;
    folder.kind = host::drive::PromiseRecord::Kind::Directory;
    folder.content = "far";
    writeFile(drive.layout().cloud() + "/far/a.txt", "a");
    drive.writePromise("Far away", folder);
    launch();
    EXPECT_THAT(offered("Far away"), ElementsAre("Download"));
    // A link to it leads to its place.
    browser->warpToNewURLPreviewMode(url("Far away"), PreviewModeDetails);
    settle();
    EXPECT_EQ(browser->viewControllers().size(), 1U);
    const auto& list = topList()->listView();
    ASSERT_EQ(list->row(list->rowCount() - 1).title, "Far away");
    list->activateRow(list->rowCount() - 1);
    settle();
    EXPECT_EQ(contentOf(url("Far away/a.txt")), "a");
    EXPECT_THAT(takeNotices(), IsEmpty());
    EXPECT_EQ(alert(), nullptr);
}

TEST_F(DownloadTest, SaysWhatCouldNotBeDownloaded)
{
    host::drive::PromiseRecord lost;
    lost.content = "lost";
    drive.writePromise("Trip/a.txt", lost);
    drive.writePromise("Trip/b.txt", lost);
    drive.writePromise("lost.txt", lost);
    launch();
    choose(menuOf("Trip"), "Download");
    EXPECT_EQ(takeAlert(), "2 items couldn’t be downloaded.");
    choose(menuOf("lost.txt"), "Download");
    EXPECT_EQ(takeAlert(), "The content of the document isn’t in the cloud.");
}

TEST_F(DownloadTest, WhatRunsIsListedAndCanBeCancelled)
{
    for (const char* name : {"a.txt", "b.txt", "c.txt", "d.txt"}) {
        write(name);
        ASSERT_TRUE(FileUtils::evictDocument(url(name)));
    }
    launch();
    choose(topList()->optionsMenu(), "Downloads");
    const auto stack =
        std::dynamic_pointer_cast<kit::NavigationController>(browser->presentedViewController());
    ASSERT_NE(stack, nullptr);
    const auto screen = std::dynamic_pointer_cast<DownloadsScreen>(stack->topViewController());
    ASSERT_NE(screen, nullptr);
    screen->view();
    EXPECT_FALSE(screen->placeholder()->isHidden());
    browser->downloads()->add({url("a.txt"), url("b.txt"), url("c.txt"), url("d.txt")});
    const auto& list = *screen->listView();
    ASSERT_EQ(list.rowCount(), 4U);
    EXPECT_TRUE(screen->placeholder()->isHidden());
    EXPECT_EQ(list.row(0).title, "a.txt");
    EXPECT_EQ(list.row(3).detail, "Waiting");
    screen->listView()->activateRow(3);
    const auto question = std::dynamic_pointer_cast<kit::AlertController>(screen->presentedViewController());
    ASSERT_NE(question, nullptr);
    EXPECT_EQ(question->title(), "d.txt");
    question->press(0);
    EXPECT_EQ(list.rowCount(), 3U);
    EXPECT_TRUE(screen->listView()->commandRow(0, kit::RowCommand::Delete));
    settle();
    EXPECT_TRUE(isHere("b.txt") && isHere("c.txt"));
    EXPECT_FALSE(isHere("a.txt") || isHere("d.txt"));
    EXPECT_EQ(list.rowCount(), 0U);
    EXPECT_FALSE(screen->placeholder()->isHidden());
    EXPECT_TRUE(screen->navigationItem().rightItems().empty());
}

TEST_F(DownloadTest, AllEndWithTheAccount)
{
    for (const char* name : {"a.txt", "b.txt", "c.txt", "d.txt"}) {
        write(name);
        ASSERT_TRUE(FileUtils::evictDocument(url(name)));
    }
    launch();
    post(platform::Notification::ApplicationDidBecomeActive);
    browser->downloads()->add({url("a.txt"), url("b.txt"), url("c.txt"), url("d.txt")});
    cloud->token.reset();
    drive.notifications->post(platform::Notification::CloudIdentityDidChange);
    settle();
    EXPECT_FALSE(isHere("d.txt"));
    EXPECT_EQ(browser->downloads()->count().all, 0U);
    EXPECT_EQ(alert(), nullptr);
}

} // namespace
} // namespace tarrow
