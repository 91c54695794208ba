// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace platform {

/// What is known of an app. An empty text means that the app does not say.
struct AppHandle {
    std::string bundleIdentifier;
    std::string localizedName, localizedShortName, itemName;
    std::string shortVersion, vendorName, executableName;
    std::optional<Url> bundleContainerURL; ///< the folder that the app is described in
    bool isInstalled = false;
    std::string itemIdentifier;
    std::string description;
    bool supportsOpenInPlace = false; ///< works on a document where it lies, in a window of its own

    /// Whether both stand for the same app.
    bool operator==(const AppHandle& other) const { return bundleIdentifier == other.bundleIdentifier; }
};
std::string logText(const AppHandle& app);

/// A document that apps are looked for.
struct DocumentHandle {
    Url url;
};

/// Apps that claim a document in the same way.
struct RankedApps {
    std::string rank;
    std::vector<AppHandle> apps;
};

/// The rank of apps that own a document's type.
inline constexpr std::string_view ownerRank = "Owner";

/// The apps of this machine. Main thread; a first call may read the apps' descriptions.
class AppRegistry {
public:
    virtual ~AppRegistry() = default;

    /// The apps that claim a document, judged by its name; owners first, the preferred one before others.
    /// Empty when none does or they cannot be listed.
    virtual std::vector<RankedApps> availableApps(const DocumentHandle& document) const = 0;
    /// Nothing when no such app is installed.
    virtual std::optional<AppHandle> appWithBundleIdentifier(const std::string& identifier) const = 0;
    /// The program's own.
    virtual std::string ownBundleIdentifier() const = 0;

    /// Has an app open a document where it lies. False when nothing is there (a promise has no content yet)
    /// or the app cannot be started.
    virtual bool openInPlace(const Url& document, const AppHandle& app) = 0;
};

} // namespace platform
