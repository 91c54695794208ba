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

/// Whether a document is opened in another app, and in which. No app means: show the preview. Main thread.
class LaunchUtils {
public:
    using App = platform::AppHandle;

    LaunchUtils() = delete;

    /// Opens a document in its default app; whether it was. The screen is where the platform may ask first.
    static bool openInDefaultAppViewControllerRequireOpenIn(const Url& url,
        const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn);

    /// The app that a document, promised or here, is opened in; nothing when there is none. Images, movies,
    /// sounds and PDF documents of the default container have none. In an app library the library's own app
    /// comes before others. This program is never answered.
    static std::optional<App> defaultAppForDocumentRequireOpenIn(const Url& url, bool requireOpenIn);
    /// The localized name of that app.
    static std::optional<std::string> defaultAppNameForDocumentRequireOpenIn(
        const Url& url, bool requireOpenIn);

    /// The apps that own the document's type and work on the document where it lies, in the registry's order.
    static std::vector<App> availableAppsForDoc(const platform::DocumentHandle& document);
    /// Whether the names of a URL say that it lies in the default container.
    static bool isUrlInDefaultContainer(const Url& url);
};

} // namespace tarrow
