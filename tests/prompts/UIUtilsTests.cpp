// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "kit/values/Screen.h"
#include "kit/views/View.h"
#include "platform/Services.h"
#include "prompts/UIUtils.h"
#include "tests/support/PlainTexts.h"

#include <gtest/gtest.h>

namespace tarrow {
namespace {

using kit::AlertController;
using kit::ViewController;
using platform::Error;
using platform::FileErrorCode;
using platform::PropertyDictionary;

class UIUtilsTest : public testing::Test {
protected:
    UIUtilsTest()
    {
        platform::ServiceSet set;
        set.localization = std::make_shared<testing_support::PlainTexts>();
        platform::installServices(std::move(set));
        window->setRootViewController(root);
        window->makeKeyAndVisible();
    }
    ~UIUtilsTest() override
    {
        kit::Screen::setMain({});
        platform::installServices({});
    }

    std::shared_ptr<AlertController> alert() const
    {
        return std::dynamic_pointer_cast<AlertController>(root->presentedViewController());
    }

    std::shared_ptr<ViewController> root = std::make_shared<ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 400, 800});
};

TEST_F(UIUtilsTest, WhatIsSaidAboutAnError)
{
    const auto described = [](const char* description, const char* reason) {
        PropertyDictionary information;
        if (description)
            information.emplace("LocalizedDescription", description);
        if (reason)
            information.emplace("LocalizedFailureReason", reason);
        return information;
    };
    struct Row {
        std::optional<Error> error;
        const char* shortMessage;
        const char* alertTitle;
    };
    const Row rows[] = {
        {Error(FileErrorCode::ItemExists, described("It exists", nullptr)), "Name is already taken",
            "It exists"},
        {Error("another domain", 516), "Name is already taken", "Mishap exception"},
        {Error(FileErrorCode::InvalidName, described(nullptr, "Bad name")),
            "Character not allowed in filename", "Bad name"},
        {Error("any", 1, described("Description", "Reason")), "Description", "Description"},
        {Error("any", 1, described(nullptr, "Reason")), "Reason", "Reason"},
        {Error("any", 1), "Mishap exception", "Mishap exception"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(UIUtils::bestMessage(row.error), row.shortMessage);
        UIUtils::showErrorParentViewController(*row.error, root);
        ASSERT_NE(alert(), nullptr);
        EXPECT_EQ(alert()->title(), row.alertTitle);
        EXPECT_EQ(alert()->message(), "");
        EXPECT_TRUE(alert()->press(0));
        EXPECT_EQ(alert(), nullptr);
    }
    EXPECT_EQ(UIUtils::bestMessage(std::nullopt), "");
}

TEST_F(UIUtilsTest, AMessageHasOneButtonAndMayLieOverAnother)
{
    UIUtils::showAlertMessageParentViewController("Title", "Message", root);
    UIUtils::showAlertMessageParentViewController("Second", "", root);
    ASSERT_EQ(window->presentedScreens().size(), 2);
    EXPECT_EQ(alert()->alertStyle(), kit::AlertStyle::Alert);
    ASSERT_EQ(alert()->actions().size(), 1);
    EXPECT_EQ(alert()->actions()[0]->title(), "OK");
    EXPECT_EQ(alert()->actions()[0]->style(), kit::AlertActionStyle::Default);
    UIUtils::showAlertMessageParentViewController("Nowhere", "", nullptr);
    EXPECT_EQ(window->presentedScreens().size(), 2);
}

TEST_F(UIUtilsTest, TabletsAreToldByTheirIdiom)
{
    using kit::UserInterfaceIdiom;
    EXPECT_FALSE(UIUtils::tabulaMode()) << "without a display";
    kit::Screen screen;
    for (const auto idiom : {UserInterfaceIdiom::Phone, UserInterfaceIdiom::Tablet}) {
        screen.idiom = idiom;
        kit::Screen::setMain(screen);
        EXPECT_EQ(UIUtils::tabulaMode(), idiom == UserInterfaceIdiom::Tablet);
    }
}

TEST_F(UIUtilsTest, AChildIsPutIntoItsParent)
{
    struct Child : ViewController {
        std::shared_ptr<ViewController> movedTo;
        bool viewWasInPlace = false;
        void didMoveToParentViewController(const std::shared_ptr<ViewController>& parent) override
        {
            movedTo = parent;
            viewWasInPlace = parent && view()->superview() == parent->view();
        }
    };
    const auto child = std::make_shared<Child>();
    UIUtils::addChildViewControllerChildViewController(root, child);
    EXPECT_EQ(child->parent(), root);
    EXPECT_EQ(child->movedTo, root);
    EXPECT_TRUE(child->viewWasInPlace);
    child->movedTo = nullptr;
}

} // namespace
} // namespace tarrow
