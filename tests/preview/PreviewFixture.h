// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/DRItem.h"
#include "kit/controllers/BarButtonItem.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/Window.h"
#include "kit/values/Screen.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "preview/PreviewItemManager.h"
#include "screens/list/DocumentListController.h"
#include "tests/screens/support/ScreensFixture.h"

namespace testing_support {

inline constexpr kit::TraitCollection phone{kit::SizeClass::Compact, kit::SizeClass::Regular};
inline constexpr kit::TraitCollection lying{kit::SizeClass::Compact, kit::SizeClass::Compact};
inline constexpr kit::TraitCollection tablet{kit::SizeClass::Regular, kit::SizeClass::Regular};

/// Answers the symbols of a bar's items.
inline std::vector<kit::SystemItem> symbols(const kit::BarButtonItems& items)
{
    std::vector<kit::SystemItem> found;
    for (const auto& item : items)
        found.push_back(item->systemItem());
    return found;
}

/// A manager over a stack in a window of a phone's size, with one screen below.
class PreviewFixture : public ScreensFixture {
protected:
    PreviewFixture()
    {
        navigation->setViewControllers({base}, false);
        window->setRootViewController(navigation);
        window->makeKeyAndVisible();
    }
    ~PreviewFixture() override
    {
        tarrow::LookwellItemController::defaultController()->lookwellNewItem(nullptr);
        manager = nullptr;
        kit::Screen::setMain(std::nullopt);
    }
    /// Gives the window another size, on a screen with a status bar that is so high.
    void resize(platform::Size size, const kit::TraitCollection& traits,
        kit::UserInterfaceIdiom idiom = kit::UserInterfaceIdiom::Phone, double statusBar = 0)
    {
        kit::Screen::setMain(
            kit::Screen{{0, 0, size.width, size.height}, 1, idiom, {0, 0, size.width, statusBar}});
        window->resized(size, traits);
        drive.dispatch->runUntilIdle();
        window->layoutIfNeeded();
    }
    std::shared_ptr<tarrow::DRItem> document(const char* name)
    {
        return tarrow::DRItem::initWithURL(drive.writeDocument(name, "content of " + std::string(name)));
    }
    std::shared_ptr<kit::AlertController> alert() const { return alertOver(*navigation); }
    /// Answers the last names of the shown folders, "*" for the quick preview, "i" for a details screen and
    /// "-" for another screen.
    std::vector<std::string> stack() const
    {
        std::vector<std::string> names;
        for (const auto& screen : navigation->viewControllers()) {
            const auto list = std::dynamic_pointer_cast<screens::DocumentListController>(screen);
            const auto details = std::dynamic_pointer_cast<tarrow::PreviewDetailsViewController>(screen);
            names.push_back(list        ? list->presentedURL()->lastPathComponent()
                    : screen == preview ? "*"
                    : details           ? "i"
                                        : "-");
        }
        return names;
    }

    std::shared_ptr<kit::NavigationController> navigation = std::make_shared<kit::NavigationController>();
    std::shared_ptr<kit::ViewController> base = std::make_shared<kit::ViewController>();
    std::shared_ptr<kit::Window> window = std::make_shared<kit::Window>(platform::Rect{0, 0, 360, 640});
    std::shared_ptr<tarrow::PreviewItemManager> manager =
        tarrow::PreviewItemManager::newItemManagerWithModeNavController(tarrow::PreviewModeQuick, navigation);
    std::shared_ptr<tarrow::LookwellItemController> preview =
        tarrow::LookwellItemController::defaultController();
};

} // namespace testing_support
