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
    std::optional<ShortcutItem> shortcutItem;
};

/// Hears of the application's life and of everything that enters it from outside. Main thread.
class ApplicationDelegate {
public:
    using ShortcutCompletion = std::function<void(bool)>;
    using RestorationHandler = std::function<void()>;

    virtual ~ApplicationDelegate() = default;

    /// Before state is restored; false when the launch's shortcut was handled and must not come again.
    virtual bool applicationWillFinishLaunchingWithOptions(
        Application& application, const LaunchOptions& options) = 0;
    virtual bool applicationDidFinishLaunchingWithOptions(
        Application& application, const LaunchOptions& options) = 0;
    virtual void applicationWillResignActive(Application& application) = 0;
    virtual bool applicationShouldSaveApplicationState(Application& application, StateCoder& coder) = 0;
    virtual bool applicationShouldRestoreApplicationState(Application& application, StateCoder& coder) = 0;
    /// A URL of the application's scheme was opened; whether it was handled.
    virtual bool applicationOpenURLOptions(
        Application& application, const std::string& url, const PropertyDictionary& options) = 0;
    virtual void applicationPerformActionForShortcutItemCompletionHandler(
        Application& application, const ShortcutItem& shortcut, const ShortcutCompletion& completion) = 0;
    virtual bool applicationWillContinueUserActivityWithType(
        Application& application, const std::string& type) = 0;
    virtual bool applicationContinueUserActivityRestorationHandler(
        Application& application, const UserActivity& activity, const RestorationHandler& handler) = 0;
    virtual void applicationDidFailToContinueUserActivityWithTypeError(
        Application& application, const std::string& type, const Error& error) = 0;
};

/// The application's loop.
class Application {
public:
    using DelegateFactory = std::function<std::shared_ptr<ApplicationDelegate>()>;

    virtual ~Application() = default;

    /// Runs until the last window closes. Makes the delegate once, in the process that owns the window; a
    /// second process hands its URLs and shortcuts to the first. Answers the process's exit status.
    virtual int run(int argc, char** argv, const DelegateFactory& makeDelegate) = 0;
};

} // namespace platform
