// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewItemManager.h"

#include "PreviewFixture.h"
#include "kit/controllers/SearchPresentation.h"
#include "screens/preview/PreviewContent.h"

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
    preview->lookwellNewItem(manager);
    EXPECT_FALSE(preview->currentPreviewItem());
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

} // namespace
