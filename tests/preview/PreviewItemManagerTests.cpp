// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewItemManager.h"

#include "PreviewFixture.h"
#include "items/DRItem.h"
#include "kit/controllers/SearchPresentation.h"
#include "preview/LookwellItemController.h"
#include "screens/preview/PreviewContent.h"

#include <gmock/gmock.h>

using namespace platform;
using namespace tarrow;

namespace {

using Manager = testing_support::PreviewFixture;
using Names = std::vector<std::string>;

TEST_F(Manager, PutsOnePreviewOnTopAndShowsTheNextInItsPlace)
{
    const auto first = document("First.txt");
    manager->previewItem(first);
    EXPECT_EQ(stack(), (Names{"-", "*"}));
    EXPECT_EQ(preview->itemManager(), manager);
    EXPECT_EQ(preview->arrayOfDocuments(), std::vector{first->url()});
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(preview->content()->text, "content of First.txt");

    const auto next = PreviewItemManager::newItemManagerWithModeNavController(PreviewModeQuick, navigation);
    next->previewItem(document("Second.txt"));
    EXPECT_EQ(stack(), (Names{"-", "*"}));
    EXPECT_EQ(preview->itemManager(), next);
    drive.dispatch->runUntilIdle();
    EXPECT_EQ(preview->content()->text, "content of Second.txt");
    EXPECT_TRUE(preview->isVisible());
    navigation->popViewController(false);
    EXPECT_FALSE(preview->isVisible());
}

TEST_F(Manager, OnlyKeepsAnItemThatIsNotToBeShown)
{
    manager->setItemUpdatePreview(document("First.txt"), false);
    EXPECT_EQ(stack(), Names{"-"});
    EXPECT_FALSE(manager->filePresenterRegistered());
    EXPECT_TRUE(manager->item());
    manager->setItem(nullptr);
    EXPECT_FALSE(manager->item());
    EXPECT_FALSE(manager->prepareToPreviewItem(nullptr));
    EXPECT_EQ(drive.log->count("WARNING no preview URL, nothing to show"), 1U);
}

TEST_F(Manager, IsRegisteredForTheItemThatIsShownWhileTheApplicationIsActive)
{
    manager->prepareToPreviewItem(document("First.txt"));
    EXPECT_TRUE(manager->filePresenterRegistered());
    drive.notifications->post(Notification::ApplicationWillResignActive);
    EXPECT_FALSE(manager->filePresenterRegistered());
    drive.notifications->post(Notification::ApplicationDidBecomeActive);
    EXPECT_TRUE(manager->filePresenterRegistered());
    EXPECT_EQ(drive.log->count("DEBUG Becoming active for " + logText(drive.url("First.txt"))), 1U);
    EXPECT_EQ(drive.log->count("DEBUG Preview: Using LookwellItemController, File Exists"), 1U);
}

TEST_F(Manager, DismissesASearchBeforeItShowsThePreview)
{
    base->presentViewController(std::make_shared<kit::SearchPresentation>(), false);
    manager->previewItem(document("First.txt"));
    EXPECT_FALSE(navigation->presentedViewController());
    EXPECT_EQ(stack(), (Names{"-", "*"}));

    base->presentViewController(std::make_shared<kit::ViewController>(), false);
    manager->previewItem(document("Second.txt"));
    EXPECT_TRUE(navigation->presentedViewController());
}

TEST_F(Manager, LeadsTheStackToAnotherPlace)
{
    const auto top = drive.layout().defaultContainer();
    const auto topName = Url::fileURL(top).lastPathComponent();
    drive.writeDocument("Documents/Trip/Map.txt");
    EXPECT_TRUE(manager->warpToNewURL(drive.url("Documents/Trip/Map.txt")));
    EXPECT_EQ(stack(), (Names{topName, "Documents", "Trip", "*"}));
    EXPECT_EQ(manager->item()->url(), drive.url("Documents/Trip/Map.txt"));
    EXPECT_TRUE(manager->filePresenterRegistered());

    base->presentViewController(std::make_shared<kit::ViewController>(), false);
    EXPECT_TRUE(manager->warpToNewURL(drive.url("Documents")));
    EXPECT_EQ(stack(), (Names{topName, "Documents"}));
    EXPECT_FALSE(manager->filePresenterRegistered());

    for (const auto& nowhere : {drive.url("Documents/Gone/File.txt"), Url::fileURL("/usr")}) {
        EXPECT_FALSE(manager->warpToNewURL(nowhere));
        EXPECT_EQ(stack(), (Names{topName, "Documents"}));
    }
    EXPECT_EQ(
        drive.log->count("ERROR : Couldn't build DLC stack for " + logText(Url::fileURL("/usr")) + "."), 1U);
    EXPECT_EQ(drive.log->count("ERROR Can't build DLC stack, can't get directory: "
                  + logText(drive.url("Documents/Gone/File.txt"))),
        1U);
}

TEST_F(Manager, HasNothingToShowWithoutAnItem)
{
    preview->lookwellNewItem(manager);
    EXPECT_FALSE(preview->arrayOfDocuments());
    EXPECT_FALSE(preview->currentPreviewItem());
    manager = nullptr;
    EXPECT_FALSE(preview->itemManager());
}

TEST_F(Manager, KnowsPdfDocumentsByTheirNames)
{
    EXPECT_TRUE(preview->_lwPreviewItemIsPDFKind(drive.url("Plan.pdf")));
    for (const auto* name : {"Plan.txt", "Plan", "Plan.unknown", "pdf"})
        EXPECT_FALSE(preview->_lwPreviewItemIsPDFKind(drive.url(name))) << name;
}

} // namespace
