// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"
#include "platform/AppRegistry.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class ViewController;
}

namespace tarrow {

/// Decides whether a document is opened in another app, and in which one. No app means that the preview is
/// shown. Main thread.
class LaunchUtils {
public:
    using App = platform::AppHandle;

    LaunchUtils() = delete;

    /// Opens a document in its default app and answers whether it did. The platform may first ask on the
    /// screen.
    static bool openInDefaultAppViewControllerRequireOpenIn(
        const Url& url, const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn);

    /// Answers the app that opens a document, promised or here, or nothing. Images, movies, sounds and PDF
    /// documents of the default container have none. In an app library the library's own app comes before
    /// others. This program is never answered.
    static std::optional<App> defaultAppForDocumentRequireOpenIn(const Url& url, bool requireOpenIn);
    /// Answers the localized name of that app.
    static std::optional<std::string> defaultAppNameForDocumentRequireOpenIn(
        const Url& url, bool requireOpenIn);

    /// Answers the apps that own the document's type and can open the document in its place, in the
    /// registry's order.
    static std::vector<App> availableAppsForDoc(const platform::DocumentHandle& document);
    /// Answers whether the names in a URL say that it lies in the default container.
    static bool isUrlInDefaultContainer(const Url& url);
};

} // namespace tarrow
