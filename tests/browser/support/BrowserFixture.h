// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "browser/NavController.h"
#include "items/DRItem.h"
#include "platform/StateCoder.h"
#include "platform/UserDefaults.h"
#include "preview/PreviewMode.h"
#include "tests/support/DriveFixture.h"
#include "tests/support/ForwardingCoordinator.h"
#include "tests/support/RecordingShortcuts.h"
#include "tests/support/SimulatedApps.h"
#include "tests/support/SimulatedCloud.h"
#include "tests/support/SimulatedOffers.h"

namespace screens {
class DocumentListController;
}
namespace kit {
class AlertController;
class Window;
} // namespace kit

namespace testing_support {

class ShownNotices;

/// Calls the test while a change waits for its turn.
class InterruptedCoordinator : public ForwardingCoordinator {
public:
    using ForwardingCoordinator::ForwardingCoordinator;
    Failure coordinateWriting(
        const Url& url, platform::WritingOptions options, const Accessor& accessor) override
    {
        wait();
        return ForwardingCoordinator::coordinateWriting(url, options, accessor);
    }
    Failure coordinateWriting(const Url& first, platform::WritingOptions firstOptions, const Url& second,
        platform::WritingOptions secondOptions, const PairAccessor& accessor) override
    {
        wait();
        return ForwardingCoordinator::coordinateWriting(first, firstOptions, second, secondOptions, accessor);
    }
    std::function<void()> whileWaiting;

private:
    void wait() const
    {
        if (whileWaiting)
            whileWaiting();
    }
};

/// A browser in a window, on the real store in a temporary folder. Only the account's token, the quota, the
/// storage offers, other apps and the clock are simulated.
class BrowserFixture : public testing::Test {
protected:
    using List = std::shared_ptr<screens::DocumentListController>;

    BrowserFixture();

    /// Makes a new browser, shows it and waits until its root list has reported its contents.
    void launch();
    void launchWithoutListing();
    /// Runs all work that is due now.
    void settle() { drive.settle(); }
    /// Posts a notification and runs the work that follows.
    void post(platform::Notification notice);
    /// Leads the browser to an item, and runs the work that follows. Answers whether it let itself be led.
    bool warp(const char* path, int mode = tarrow::PreviewModeQuick);

    platform::Url url(std::string_view relativePath) const { return drive.url(relativePath); }
    platform::Url write(std::string_view relativePath, std::string_view content = "content") const
    {
        return drive.writeDocument(relativePath, content);
    }
    static platform::UserDefaults& defaults() { return platform::services().userDefaults(); }
    List topList() const { return browser->getTopDocumentListController(); }
    /// Answers the last names of the folders in the stack, "*" for a quick preview, "i" for a details screen
    /// and "-" for another screen.
    std::vector<std::string> stack() const;
    std::shared_ptr<kit::AlertController> alert() const;
    /// Closes the alert on the screen and answers its title; empty without one.
    std::string takeAlert();
    /// Keeps what a window tells the user from now on.
    void watch(kit::Window& shown);
    /// Answers what the window told the user since the last call.
    std::vector<std::string> takeNotices();
    /// Presses the button of the latest of these messages.
    void pressNotice();
    /// Answers the catalogue's text for a number of items.
    static std::string itemsText(std::size_t count);

    DriveFixture drive;
    const std::shared_ptr<RecordingLog>& log = drive.log;
    const std::shared_ptr<VirtualDispatch>& dispatch = drive.dispatch;
    std::shared_ptr<InterruptedCoordinator> coordinator;
    std::shared_ptr<SimulatedCloud> cloud;
    std::shared_ptr<SimulatedApps> apps = std::make_shared<SimulatedApps>();
    std::shared_ptr<RecordingShortcuts> shortcuts = std::make_shared<RecordingShortcuts>();
    std::shared_ptr<SimulatedOffers> offers = std::make_shared<SimulatedOffers>();
    std::shared_ptr<ShownNotices> notices;
    std::shared_ptr<kit::Window> window;
    std::shared_ptr<tarrow::NavController> browser;
};

} // namespace testing_support
