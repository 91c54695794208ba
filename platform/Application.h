// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/StateCoder.h"
#include "platform/Url.h"
#include "platform/UserActivity.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace platform {

class Application;

/// How the application was launched.
struct LaunchOptions {
    /// The launcher's shortcut that started the process; nothing for every other start.
    std::optional<ShortcutItem> shortcutItem;
};

/// Hears of the application's life and of everything that enters it from outside. All calls come on the main
/// thread. A launch calls, in this order: will-finish-launching, should-restore (when there is saved state,
/// and no shortcut that must not be covered by it), did-finish-launching, and then whatever the launch was
/// asked to show.
class ApplicationDelegate {
public:
    using ShortcutCompletion = std::function<void(bool)>;
    using RestorationHandler = std::function<void()>;

    virtual ~ApplicationDelegate() = default;

    /// Called once, before saved state is restored; the delegate makes the window here. It answers false when
    /// it has handled the launch's shortcut itself, so that the shortcut is not performed a second time.
    virtual bool applicationWillFinishLaunchingWithOptions(
        Application& application, const LaunchOptions& options) = 0;
    /// Called once, after saved state was restored. The loop ignores the answer.
    virtual bool applicationDidFinishLaunchingWithOptions(
        Application& application, const LaunchOptions& options) = 0;
    /// Called whenever the window is minimised or closed, or the process ends. Then
    /// Notification::ApplicationWillResignActive follows, and the state is saved. A window that only loses
    /// the focus stays active, because the user may look at it beside another one.
    virtual void applicationWillResignActive(Application& application) = 0;
    /// Called each time before the interface's state is saved. The delegate may add values of its own to the
    /// coder. When it answers false nothing is kept, and what was kept before is removed.
    virtual bool applicationShouldSaveApplicationState(Application& application, StateCoder& coder) = 0;
    /// Called at most once in a launch, with the values that the delegate saved. When it answers false the
    /// saved state is not used. It is not called when no interface state was saved.
    virtual bool applicationShouldRestoreApplicationState(Application& application, StateCoder& coder) = 0;
    /// Called for each URL that another program or the command line wants opened, as the text that came in:
    /// it need not be a URL at all. The delegate answers whether it handled it; `options` is empty on Linux.
    virtual bool applicationOpenURLOptions(
        Application& application, const std::string& url, const PropertyDictionary& options) = 0;
    /// Called when one of the launcher's shortcuts is chosen. The delegate calls the completion once, with
    /// whether it performed the shortcut.
    virtual void applicationPerformActionForShortcutItemCompletionHandler(
        Application& application, const ShortcutItem& shortcut, const ShortcutCompletion& completion) = 0;
    /// Called before an activity of this type is continued. When the delegate answers false the activity is
    /// dropped without a further call.
    virtual bool applicationWillContinueUserActivityWithType(
        Application& application, const std::string& type) = 0;
    /// Called with the activity itself, right after the call above answered true. The delegate answers
    /// whether it continued it.
    virtual bool applicationContinueUserActivityRestorationHandler(
        Application& application, const UserActivity& activity, const RestorationHandler& handler) = 0;
    /// Called when an activity that the person chose could not be had, with the reason. The loop tells the
    /// person right afterwards, so the delegate need not.
    virtual void applicationDidFailToContinueUserActivityWithTypeError(
        Application& application, const std::string& type, const Error& error) = 0;
};

/// The application's loop, which a host implements with its toolkit.
class Application {
public:
    using DelegateFactory = std::function<std::shared_ptr<ApplicationDelegate>()>;

    virtual ~Application() = default;

    /// Runs until the last window closes, on the thread that calls, which becomes the main thread. It makes
    /// the delegate once, in the process that owns the window; a second process hands its URLs and shortcuts
    /// to the first one, makes no delegate and ends. It answers the process's exit status in the terms of
    /// sysexits.h: 0, 64 for an unknown option, 69 when there is no display.
    virtual int run(int argc, char** argv, const DelegateFactory& makeDelegate) = 0;
};

} // namespace platform
