// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/browser/support/BrowserFixture.h"

#include "host/system/texts/GettextLocalization.h"
#include "host/system/texts/UserLocale.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "platform/Localization.h"
#include "preview/LookwellItemController.h"
#include "preview/PreviewDetailsViewController.h"
#include "screens/list/DocumentListController.h"
#include "tests/support/RecordingSharing.h"

namespace testing_support {

using kit::Window;
using screens::DocumentListController;

/// A host that shows no movements and keeps the window's messages.
class ShownNotices : public kit::WindowObserver {
public:
    void rootDidChange(Window&) override { }
    void windowWillPresent(Window&, const kit::Presentation&, kit::TransitionToken token) override
    {
        token.finish();
    }
    void windowWillDismiss(Window&, const kit::Presentation&, kit::TransitionToken token) override
    {
        token.finish();
    }
    void windowShowsNotice(Window&, const std::string& text, const kit::NoticeAction& shown) override
    {
        texts.push_back(text);
        action = shown;
    }

    std::vector<std::string> texts;
    kit::NoticeAction action; ///< of the latest one
};

BrowserFixture::BrowserFixture()
{
    cloud = std::make_shared<SimulatedCloud>(drive.cloud);
    auto set = drive.installed;
    set.appRegistry = apps;
    set.cloudDocumentService = cloud;
    coordinator = std::make_shared<InterruptedCoordinator>(set.fileCoordinator);
    set.fileCoordinator = coordinator;
    set.documentSharing = std::make_shared<RecordingSharing>();
    set.localization = std::make_shared<host::system::GettextLocalization>(
        TRW_LOCALE_FOLDER, host::system::UserLocale{"en", "en_US"});
    set.launcherShortcuts = shortcuts;
    set.storageOfferManager = offers;
    platform::installServices(std::move(set));
}

void BrowserFixture::launchWithoutListing()
{
    browser = std::make_shared<tarrow::NavController>();
    window = std::make_shared<Window>(platform::Rect{0, 0, 400, 800});
    watch(*window);
    window->setRootViewController(browser);
    window->makeKeyAndVisible();
}

void BrowserFixture::launch()
{
    launchWithoutListing();
    settle();
}

void BrowserFixture::post(platform::Notification notice)
{
    drive.notifications->post(notice);
    settle();
}

bool BrowserFixture::warp(const char* path, int mode)
{
    const bool isLed = browser->warpToNewURLPreviewMode(url(path), mode);
    settle();
    return isLed;
}

std::vector<std::string> BrowserFixture::stack() const
{
    std::vector<std::string> names;
    for (const auto& screen : browser->viewControllers()) {
        const auto list = std::dynamic_pointer_cast<DocumentListController>(screen);
        if (list)
            names.push_back(list->presentedURL() ? list->presentedURL()->lastPathComponent() : "");
        else if (std::dynamic_pointer_cast<tarrow::PreviewDetailsViewController>(screen))
            names.emplace_back("i");
        else
            names.emplace_back(std::dynamic_pointer_cast<tarrow::LookwellItemController>(screen) ? "*" : "-");
    }
    return names;
}

std::shared_ptr<kit::AlertController> BrowserFixture::alert() const
{
    return std::dynamic_pointer_cast<kit::AlertController>(browser->presentedViewController());
}

std::string BrowserFixture::takeAlert()
{
    const auto shown = alert();
    const auto title = shown ? shown->title() : std::string();
    if (shown)
        shown->press(0);
    settle();
    return title;
}

void BrowserFixture::watch(kit::Window& shown)
{
    notices = std::make_shared<ShownNotices>();
    shown.setObserver(notices);
}

std::vector<std::string> BrowserFixture::takeNotices()
{
    return std::exchange(notices->texts, {});
}

void BrowserFixture::pressNotice()
{
    if (const auto press = notices->action.run)
        press();
    settle();
}

std::string BrowserFixture::itemsText(std::size_t count)
{
    return platform::localizedPlural(".DICT.ITEMS.%d", {static_cast<std::int64_t>(count)});
}

} // namespace testing_support
