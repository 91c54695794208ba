// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Application.h"

#include <memory>
#include <optional>
#include <string>

namespace kit {
class Window;
}

namespace tarrow {

class NavController;

/// Creates the application's one window with the browser, and passes to the browser everything that enters
/// the application from outside. Made with std::make_shared. Main thread only.
class AppDelegate : public platform::ApplicationDelegate, public std::enable_shared_from_this<AppDelegate> {
public:
    /// Answers null before the launch.
    const std::shared_ptr<kit::Window>& rootWindow() const { return _rootWindow; }
    void setRootWindow(std::shared_ptr<kit::Window> window) { _rootWindow = std::move(window); }

    bool applicationWillFinishLaunchingWithOptions(
        platform::Application& application, const platform::LaunchOptions& options) override;
    bool applicationDidFinishLaunchingWithOptions(
        platform::Application& application, const platform::LaunchOptions& options) override;
    void applicationWillResignActive(platform::Application& application) override;
    /// The state is kept and restored only while somebody is signed in.
    bool applicationShouldSaveApplicationState(
        platform::Application& application, platform::StateCoder& coder) override;
    bool applicationShouldRestoreApplicationState(
        platform::Application& application, platform::StateCoder& coder) override;
    bool applicationOpenURLOptions(platform::Application& application, const std::string& url,
        const platform::PropertyDictionary& options) override;
    /// The completion is never called.
    void applicationPerformActionForShortcutItemCompletionHandler(platform::Application& application,
        const platform::ShortcutItem& shortcut, const ShortcutCompletion& completion) override;
    bool applicationWillContinueUserActivityWithType(
        platform::Application& application, const std::string& type) override;
    /// The handler is never called.
    bool applicationContinueUserActivityRestorationHandler(platform::Application& application,
        const platform::UserActivity& activity, const RestorationHandler& handler) override;
    void applicationDidFailToContinueUserActivityWithTypeError(
        platform::Application& application, const std::string& type, const platform::Error& error) override;

private:
    /// Answers the window's root when it is the browser, else null; nothing is shown then.
    std::shared_ptr<NavController> browser() const;
    bool isSignedIn() const;
    /// Is called for diagnosis when the application goes to the background; it does nothing.
    void dumpWindowInfo() const;
    bool warpTo(const std::optional<platform::Url>& url, int previewMode);
    void warpLater(const platform::Url& url);
    /// Tells the user why nothing was opened.
    void tell(const std::string& notice) const;
    void openRecentDocument(const platform::PropertyDictionary& information);
    void continueSearch(const platform::UserActivity& activity);
    void openSearchResult(const platform::UserActivity& activity);
    void openHandedOverDocument(const platform::UserActivity& activity);

    std::shared_ptr<kit::Window> _rootWindow;
};

/// Logs one line at each level. It serves diagnosis; nothing calls it.
void _TarrowDriveLogTest(); // NOLINT(bugprone-reserved-identifier): called by this name from a debugger

} // namespace tarrow
