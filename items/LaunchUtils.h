// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"
#include "platform/AppRegistry.h"
#include "screens/DocumentInteractionSheet.h"

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

    /// What the disk says about a document that may be opened in an app.
    struct DocumentFacts {
        bool exists = false;
        std::optional<Url> resolved; ///< absent for a reference that cannot be read
        bool isInDefaultContainer = false;
        std::shared_ptr<const DocumentContainer> library; ///< null in the default container
        screens::DocumentInteractionSheet::ItemFacts target; ///< of what `resolved` leads to
    };
    /// Looks them up. Any thread.
    static DocumentFacts factsOf(const Url& url);

    /// An item whose menu of actions is shown: where it really lies, and what the disk says about it there.
    struct SharedItem {
        Url url;
        screens::DocumentInteractionSheet::ItemFacts facts;
    };
    /// Looks it up. Any thread.
    static SharedItem sharedItemAt(const Url& url);

    /// Opens a document in its default app and answers whether it did. The platform may first ask on the
    /// screen.
    static bool openInDefaultAppViewControllerRequireOpenIn(
        const Url& url, const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn);
    /// Does the same with facts that are known already, and looks at nothing.
    static bool openInDefaultAppFactsViewControllerRequireOpenIn(const Url& url, const DocumentFacts& facts,
        const std::shared_ptr<kit::ViewController>& viewController, bool requireOpenIn);

    /// Answers the app that opens a document, promised or here, or nothing. Images, movies, sounds and PDF
    /// documents of the default container have none. In an app library the library's own app comes before
    /// others. This program is never answered.
    static std::optional<App> defaultAppForDocumentRequireOpenIn(const Url& url, bool requireOpenIn);
    /// Answers the localized name of that app.
    static std::optional<std::string> defaultAppNameForDocumentRequireOpenIn(
        const Url& url, bool requireOpenIn);
    /// Answers it with facts that are known already, and looks at nothing.
    static std::optional<std::string> defaultAppNameForDocumentFactsRequireOpenIn(
        const DocumentFacts& facts, bool requireOpenIn);

    /// Answers the apps that own the document's type and can open the document in its place, in the
    /// registry's order.
    static std::vector<App> availableAppsForDoc(const platform::DocumentHandle& document);
    /// Answers whether the names in a URL say that it lies in the default container.
    static bool isUrlInDefaultContainer(const Url& url);
};

} // namespace tarrow
