// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/AppRegistry.h"

#include <functional>
#include <memory>
#include <string>

// NOLINTNEXTLINE(bugprone-reserved-identifier): the library's name
using GAppLaunchContext = struct _GAppLaunchContext;

namespace host::system {

class MimeTypeRegistry;

/// The apps of this machine, by its desktop entries. The user's default app for a document's MIME type ranks
/// "Owner" when it claims that very type, and so does an app whose entry lists the type under
/// "X-Tarrow-OwnedTypes". Other claimants rank "Alternate". An app opens documents in place when its command
/// takes files or URLs and needs no terminal.
class GioAppRegistry : public platform::AppRegistry {
public:
    /// Makes the context with which a launched app can bring its window to the front; null means none.
    using LaunchContext = std::function<std::shared_ptr<GAppLaunchContext>()>;

    GioAppRegistry(std::shared_ptr<const MimeTypeRegistry> types, std::string ownIdentifier,
        LaunchContext launchContext = {});

    std::vector<platform::RankedApps> availableApps(const platform::DocumentHandle& document) const override;
    std::optional<platform::AppHandle> appWithBundleIdentifier(const std::string& identifier) const override;
    std::string ownBundleIdentifier() const override { return _ownIdentifier; }
    bool openInPlace(const platform::Url& document, const platform::AppHandle& app) override;

private:
    std::optional<std::string> mimeTypeOf(const platform::Url& url) const;

    std::shared_ptr<const MimeTypeRegistry> _types;
    std::string _ownIdentifier;
    LaunchContext _launchContext;
};

} // namespace host::system
