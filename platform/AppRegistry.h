// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// What is known of an app. A text is empty where the app's description does not give it.
struct AppHandle {
    /// Tells apps apart: the name of the desktop entry without ".desktop", such as "org.gnome.TextEditor".
    std::string bundleIdentifier;
    /// The names for people, in the user's language, and the file name of the app's description.
    std::string localizedName, localizedShortName, itemName;
    /// The host on Linux leaves the version and the vendor empty, because desktop entries have neither.
    std::string shortVersion, vendorName, executableName;
    /// The folder that holds the app's description.
    std::optional<Url> bundleContainerURL;
    bool isInstalled = false;
    /// The identifier of the app's description; on Linux the same as `itemName`.
    std::string itemIdentifier;
    /// Says in the user's language what the app does.
    std::string description;
    /// Whether the app works on a document where the document lies, in a window of the app's own.
    bool supportsOpenInPlace = false;

    /// Two handles are equal when they name the same app; what else they say of it does not matter.
    bool operator==(const AppHandle& other) const { return bundleIdentifier == other.bundleIdentifier; }
};
/// The text of an app in a log line: its name for people and its identifier.
std::string logText(const AppHandle& app);

/// A document for which apps are looked up. Only its name is looked at, and it need not exist.
struct DocumentHandle {
    Url url;
};

/// Apps that claim a document in the same way.
struct RankedApps {
    std::string rank; ///< ownerRank, or "Alternate" for apps that merely can open the type
    std::vector<AppHandle> apps; ///< never empty; the preferred app comes first
};

/// The rank of apps that own a document's type: the person's default app for exactly this type, and apps that
/// declare the type as their own.
inline constexpr std::string_view ownerRank = "Owner";

/// The apps of this machine and their claims to documents. Main thread only; the first call may wait while
/// the apps' descriptions are read from the disk.
class AppRegistry {
public:
    virtual ~AppRegistry() = default;

    /// Answers the apps that claim a document, judged by the extension of its name: owners before all others.
    /// A rank without apps is left out. The answer is empty when the type is unknown, when no app claims it,
    /// and when the apps cannot be listed.
    virtual std::vector<RankedApps> availableApps(const DocumentHandle& document) const = 0;
    /// Answers what is known of an app. It answers nothing when no app with this identifier is installed.
    virtual std::optional<AppHandle> appWithBundleIdentifier(const std::string& identifier) const = 0;
    /// Answers the program's own identifier, which is no app of the answers above unless it is installed.
    virtual std::string ownBundleIdentifier() const = 0;

    /// Has an app open a document where the document lies, and answers whether the app was started; what the
    /// app then does is not waited for. Whether something lies at the location is the caller's to look up,
    /// because the disk may be slow. It answers false when the app is not installed any more, and when it
    /// cannot be started, which is logged with the reason.
    virtual bool openInPlace(const Url& document, const AppHandle& app) = 0;
};

} // namespace platform
