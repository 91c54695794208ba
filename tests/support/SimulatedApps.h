// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/AppRegistry.h"

#include <algorithm>
#include <string>
#include <vector>

namespace testing_support {

/// Apps that the test chooses; there are none at first.
class SimulatedApps : public platform::AppRegistry {
public:
    struct Opened {
        platform::Url document;
        std::string app;
        bool operator==(const Opened&) const = default;
    };

    std::vector<platform::RankedApps> available; ///< the apps for every document
    std::vector<platform::AppHandle> known;
    bool appsStart = true; ///< whether an app starts when it is asked to open something
    std::vector<Opened> opened;

    static platform::AppHandle make(const std::string& identifier, bool supportsOpenInPlace = true)
    {
        platform::AppHandle app;
        app.bundleIdentifier = identifier;
        app.localizedName = "The " + identifier;
        app.isInstalled = true;
        app.supportsOpenInPlace = supportsOpenInPlace;
        return app;
    }

    std::vector<platform::RankedApps> availableApps(const platform::DocumentHandle&) const override
    {
        return available;
    }
    std::optional<platform::AppHandle> appWithBundleIdentifier(const std::string& identifier) const override
    {
        const auto found = std::ranges::find(known, identifier, &platform::AppHandle::bundleIdentifier);
        return found == known.end() ? std::nullopt : std::optional(*found);
    }
    std::string ownBundleIdentifier() const override { return "own"; }
    bool openInPlace(const platform::Url& document, const platform::AppHandle& app) override
    {
        if (appsStart)
            opened.push_back({document, app.bundleIdentifier});
        return appsStart;
    }
};

} // namespace testing_support
