// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "screens/StorageUpgradeButton.h"
#include "screens/UpgradeFlow.h"
#include "tests/screens/support/ComponentsFixture.h"

using namespace platform;
using namespace screens;
using namespace testing;

namespace {

std::shared_ptr<const StorageOffer> offer(bool storageIsLow, const std::string& title = {})
{
    return std::make_shared<const StorageOffer>(StorageOffer{.level = 1,
        .storageIsLow = storageIsLow,
        .buttonTitle = title,
        .link = {StorageOfferLink::actionUpgradeInApplication, "https://example.org/more"}});
}

class Storage : public testing_support::ComponentsFixture {
protected:
    Storage()
    {
        window->setRootViewController(root);
        window->makeKeyAndVisible();
    }
    std::shared_ptr<kit::AlertController> alert() const
    {
        return std::dynamic_pointer_cast<kit::AlertController>(root->presentedViewController());
    }

    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(Rect{0, 0, 360, 640});
    std::shared_ptr<kit::ViewController> root = std::make_shared<kit::ViewController>();
};

TEST_F(Storage, OffersAnUpgradeWhileStorageIsLow)
{
    EXPECT_FALSE(StorageUpgradeButton::shouldShowForOffer(nullptr));
    EXPECT_FALSE(StorageUpgradeButton::shouldShowForOffer(offer(false)));
    EXPECT_TRUE(StorageUpgradeButton::shouldShowForOffer(offer(true)));

    const auto button = StorageUpgradeButton::createButton();
    const auto plain = button->titleLabel()->text();
    EXPECT_FALSE(plain.empty());
    EXPECT_EQ(button->link().action(), 0);
    button->setOffer(offer(true, "Get 50 GB"));
    EXPECT_EQ(button->titleLabel()->text(), "Get 50 GB");
    EXPECT_EQ(button->link().action(), StorageOfferLink::actionUpgradeInApplication);
    EXPECT_FALSE(button->link().performDefaultAction());
    button->setOffer(nullptr);
    EXPECT_EQ(button->titleLabel()->text(), plain);
}

TEST_F(Storage, OpensTheOffersPageOnlyWhenAskedTo)
{
    UpgradeFlow::initWithOffer(nullptr)->beginWithPresentingViewController(root);
    EXPECT_FALSE(alert());

    const auto flow = UpgradeFlow::initWithOffer(offer(true));
    flow->beginWithPresentingViewController(root);
    ASSERT_TRUE(alert());
    alert()->userCancelled();
    EXPECT_THAT(links->opened, IsEmpty());

    links->answer = Error(FileErrorCode::Unsupported);
    flow->beginWithPresentingViewController(root);
    ASSERT_TRUE(alert());
    alert()->press(alert()->preferredAction());
    EXPECT_THAT(links->opened, ElementsAre("https://example.org/more"));
    ASSERT_TRUE(alert());
    EXPECT_EQ(alert()->title(), "The page cannot be opened");
}

} // namespace
