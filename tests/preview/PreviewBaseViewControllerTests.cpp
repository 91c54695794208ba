// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewBaseViewController.h"

#include "PreviewFixture.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/values/Screen.h"
#include "kit/views/Button.h"
#include "kit/views/ScrollView.h"
#include "screens/DocumentInteractionSheet.h"
#include "screens/PlaceholderView.h"

using namespace platform;
using namespace tarrow;
using kit::SystemItem;
using testing::ElementsAre;

namespace {

using testing_support::lying;
using testing_support::phone;
using testing_support::symbols;
using testing_support::tablet;

/// A screen with a button that opens the item in another app.
class ScreenWithButton : public PreviewBaseViewController {
public:
    std::shared_ptr<kit::Button> openInAppNavControllerButton() override { return button; }
    std::shared_ptr<kit::Button> button;
};

class Base : public testing_support::PreviewFixture {
protected:
    Base() { resize({360, 640}, phone); }

    void resize(Size size, const kit::TraitCollection& traits,
        kit::UserInterfaceIdiom idiom = kit::UserInterfaceIdiom::Phone)
    {
        constexpr double statusBar = 20;
        PreviewFixture::resize(size, traits, idiom, statusBar);
    }
    std::shared_ptr<ScreenWithButton> show(const std::shared_ptr<DRItem>& item)
    {
        manager->setItemUpdatePreview(item, false);
        const auto screen = std::make_shared<ScreenWithButton>();
        screen->setItemManager(manager);
        navigation->pushViewController(screen, false);
        window->layoutIfNeeded();
        return screen;
    }
};

TEST_F(Base, ContentLiesBetweenTheBars)
{
    const auto screen = show(document("Notes.txt"));
    navigation->barsResized({{0, 0, 360, 44}, {0, 0, 360, 50}});
    window->layoutIfNeeded();
    EXPECT_EQ(screen->contentView()->frame(), (Rect{0, 0, 360, 640 - 20 - 44 - 50}));
    EXPECT_EQ(screen->scrollView()->contentSize(), (Size{360, 526}));
    EXPECT_EQ(screen->scrollView()->frame(), (Rect{0, 0, 360, 640}));
    EXPECT_EQ(screen->wrapperView()->frame(), (Rect{0, 0, 360, 526 - 17}));

    navigation->setToolbarHidden(true);
    screen->view()->setNeedsLayout();
    window->layoutIfNeeded();
    EXPECT_EQ(screen->contentView()->frame().height, 640 - 20 - 44) << "a hidden toolbar takes nothing";
}

TEST_F(Base, OnlyAnUprightScreenHasABottomMargin)
{
    const auto screen = show(document("Notes.txt"));
    const struct {
        const char* what;
        Size size;
        kit::TraitCollection traits;
        double margin;
    } rows[] = {
        {"phone", {360, 640}, phone, -17},
        {"phone on its side", {640, 360}, lying, 0},
        {"tablet", {768, 1024}, tablet, -17},
        {"narrow part of a tablet on its side", {1024, 768}, phone, -17},
    };
    for (const auto& row : rows) {
        resize(row.size, row.traits);
        EXPECT_EQ(screen->currentPseudoOrientation() <= 2, row.margin != 0) << row.what;
        EXPECT_EQ(screen->parentBottomConstraint()->constant(), row.margin) << row.what;
    }
}

TEST_F(Base, APhoneHasItsButtonsBelowAndATabletAbove)
{
    const auto screen = show(document("Notes.txt"));
    EXPECT_THAT(symbols(screen->toolbarItems()),
        ElementsAre(SystemItem::Action, SystemItem::FlexibleSpace, SystemItem::Trash,
            SystemItem::FlexibleSpace, SystemItem::Organize));
    EXPECT_FALSE(navigation->isToolbarHidden());
    EXPECT_TRUE(screen->navigationItem().rightItems().empty());

    resize({1024, 768}, tablet, kit::UserInterfaceIdiom::Tablet);
    EXPECT_THAT(symbols(screen->navigationItem().rightItems()),
        ElementsAre(SystemItem::Action, SystemItem::FixedSpace, SystemItem::Trash, SystemItem::FixedSpace,
            SystemItem::Organize));
    EXPECT_TRUE(navigation->isToolbarHidden());
    EXPECT_EQ(screen->barButtonActionItem(), screen->navigationItem().rightItems().front());

    resize({360, 640}, phone);
    EXPECT_TRUE(screen->navigationItem().rightItems().empty());
    EXPECT_EQ(screen->barButtonMoveItem(), screen->toolbarItems().back());
}

TEST_F(Base, NothingCanBeDoneWithoutAnItem)
{
    const auto screen = show(nullptr);
    const auto expectEnabled = [&](bool isEnabled) {
        for (const auto& button :
            {screen->barButtonActionItem(), screen->barButtonDeleteItem(), screen->barButtonMoveItem()})
            EXPECT_EQ(button->isEnabled(), isEnabled);
    };
    expectEnabled(false);
    screen->showDocumentActivities(nullptr);
    screen->showMoveTarget(nullptr);
    EXPECT_FALSE(navigation->presentedViewController());
    manager->setItemUpdatePreview(document("Notes.txt"), false);
    screen->refreshItem();
    expectEnabled(true);
    manager = nullptr;
    screen->refreshItem();
    expectEnabled(false);
}

TEST_F(Base, TheOpenButtonStandsInAPhonesBar)
{
    const auto screen = show(document("Notes.txt"));
    screen->button = std::make_shared<kit::Button>("Open");
    screen->configureButtons();
    ASSERT_EQ(screen->navigationItem().rightItems().size(), 1U);
    EXPECT_TRUE(screen->button->press());
    drive.settle();
    EXPECT_EQ(drive.log->count(
                  "WARNING Failed to open document " + logText(drive.url("Notes.txt")) + " in default app"),
        1U)
        << "there is no such app";
    screen->setMode(PreviewModeQuick);
    screen->configureButtons();
    EXPECT_TRUE(screen->navigationItem().rightItems().empty());
}

TEST_F(Base, SharesTheDocumentThatTheItemStandsForAndAsksBeforeItDeletes)
{
    const auto screen = show(document("Notes.txt"));
    EXPECT_TRUE(screen->barButtonActionItem()->press());
    drive.settle();
    const auto sheet = manager->documentInteractionController();
    ASSERT_TRUE(sheet);
    EXPECT_EQ(sheet->url(), drive.url("Notes.txt"));
    EXPECT_TRUE(alert());
    navigation->dismissViewController(false);
    EXPECT_TRUE(screen->barButtonDeleteItem()->press());
    drive.settle();
    ASSERT_TRUE(alert());
    EXPECT_EQ(std::get<std::weak_ptr<kit::BarButtonItem>>(alert()->popoverAnchor()).lock(),
        screen->barButtonDeleteItem());
    navigation->dismissViewController(false);

    const auto nowhere = document("Other.txt");
    nowhere->setResolvedURL(std::nullopt);
    manager->setItemUpdatePreview(nowhere, false);
    EXPECT_TRUE(screen->barButtonActionItem()->press());
    EXPECT_EQ(drive.log->count("WARNING showDocumentActivities: url is wrong class: (null)"), 1U);
    EXPECT_FALSE(navigation->presentedViewController());
}

} // namespace
