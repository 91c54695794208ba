// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GioAppRegistry.h"

#include "host/system/desktop/MimeTypeRegistry.h"
#include "platform/Log.h"

#include <gio/gdesktopappinfo.h>
#include <gio/gio.h>

#include <algorithm>

namespace host::system {

using platform::AppHandle;
using platform::Url;

namespace {

constexpr std::string_view entrySuffix = ".desktop";
constexpr auto ownedTypesKey = "X-Tarrow-OwnedTypes";

struct Unref {
    void operator()(gpointer object) const { g_object_unref(object); }
};
using App = std::unique_ptr<GAppInfo, Unref>;

/// Takes over a list and the apps in it.
std::vector<App> owned(GList* list)
{
    std::vector<App> apps;
    for (const auto* link = list; link; link = link->next)
        apps.emplace_back(G_APP_INFO(link->data));
    g_list_free(list);
    return apps;
}

std::string text(const char* value)
{
    return value ? value : "";
}

GDesktopAppInfo* entryOf(const App& app)
{
    return G_DESKTOP_APP_INFO(app.get());
}

std::string identifierOf(const App& app)
{
    auto identifier = text(g_app_info_get_id(app.get()));
    if (identifier.ends_with(entrySuffix))
        identifier.resize(identifier.size() - entrySuffix.size());
    return identifier;
}

bool opensInPlace(const App& app)
{
    return (g_app_info_supports_files(app.get()) || g_app_info_supports_uris(app.get()))
        && !g_desktop_app_info_get_boolean(entryOf(app), G_KEY_FILE_DESKTOP_KEY_TERMINAL);
}

AppHandle handleOf(const App& app)
{
    AppHandle handle;
    handle.bundleIdentifier = identifierOf(app);
    handle.localizedName = text(g_app_info_get_display_name(app.get()));
    handle.localizedShortName = text(g_app_info_get_name(app.get()));
    handle.itemName = text(g_app_info_get_id(app.get()));
    handle.executableName = text(g_app_info_get_executable(app.get()));
    if (const char* path = g_desktop_app_info_get_filename(entryOf(app)))
        handle.bundleContainerURL = Url::fileURL(path).deletingLastPathComponent();
    handle.isInstalled = true;
    handle.itemIdentifier = handle.itemName;
    handle.description = text(g_app_info_get_description(app.get()));
    handle.supportsOpenInPlace = opensInPlace(app);
    return handle;
}

bool declaresAsOwn(const App& app, const std::string& mimeType)
{
    gsize count = 0;
    const std::unique_ptr<char*, decltype(&g_strfreev)> types(
        g_desktop_app_info_get_string_list(entryOf(app), ownedTypesKey, &count), g_strfreev);
    return std::any_of(types.get(), types.get() + count, [&](const char* type) { return type == mimeType; });
}

/// Answers the user's default app for just this type. An app that only opens a more general type does not
/// count.
App defaultApp(const std::string& mimeType, const std::vector<App>& claimants)
{
    App app(g_app_info_get_default_for_type(mimeType.c_str(), FALSE));
    const bool claims = app && std::ranges::any_of(claimants, [&](const App& claimant) {
        return g_app_info_equal(claimant.get(), app.get());
    });
    return claims ? std::move(app) : nullptr;
}

App appWithIdentifier(const std::string& identifier)
{
    return App(identifier.empty()
            ? nullptr
            : G_APP_INFO(g_desktop_app_info_new((identifier + std::string(entrySuffix)).c_str())));
}

} // namespace

GioAppRegistry::GioAppRegistry(
    std::shared_ptr<const MimeTypeRegistry> types, std::string ownIdentifier, LaunchContext launchContext)
    : _types(std::move(types))
    , _ownIdentifier(std::move(ownIdentifier))
    , _launchContext(std::move(launchContext))
{
}

std::optional<std::string> GioAppRegistry::mimeTypeOf(const Url& url) const
{
    const auto type = _types->typeForExtension(url.pathExtension());
    auto mimeType = type ? _types->mimeType(*type) : std::nullopt;
    // A package without a type of its own is not opened with the file manager, although it is a folder.
    return mimeType && *mimeType != "inode/directory" ? std::move(mimeType) : std::nullopt;
}

std::vector<platform::RankedApps> GioAppRegistry::availableApps(
    const platform::DocumentHandle& document) const
{
    const auto mimeType = mimeTypeOf(document.url);
    if (!mimeType)
        return {};
    const auto preferred =
        defaultApp(*mimeType, owned(g_app_info_get_recommended_for_type(mimeType->c_str())));
    platform::RankedApps owners{std::string(platform::ownerRank), {}}, others{"Alternate", {}};
    if (preferred)
        owners.apps.push_back(handleOf(preferred));
    for (const auto& app : owned(g_app_info_get_all_for_type(mimeType->c_str()))) {
        if (preferred && g_app_info_equal(app.get(), preferred.get()))
            continue;
        (declaresAsOwn(app, *mimeType) ? owners : others).apps.push_back(handleOf(app));
    }
    std::vector<platform::RankedApps> ranks;
    for (auto* rank : {&owners, &others}) {
        if (!rank->apps.empty())
            ranks.push_back(std::move(*rank));
    }
    return ranks;
}

std::optional<AppHandle> GioAppRegistry::appWithBundleIdentifier(const std::string& identifier) const
{
    const auto app = appWithIdentifier(identifier);
    return app ? std::optional(handleOf(app)) : std::nullopt;
}

bool GioAppRegistry::openInPlace(const Url& document, const AppHandle& app)
{
    static constexpr platform::Operation op{"-[GioAppRegistry openInPlace:app:]"};
    const auto entry = appWithIdentifier(app.bundleIdentifier);
    if (!entry)
        return false;
    auto uri = document.absoluteString();
    GList uris{uri.data(), nullptr, nullptr};
    const auto context = _launchContext ? _launchContext() : nullptr;
    GError* failure = nullptr;
    const bool started = g_app_info_launch_uris(entry.get(), &uris, context.get(), &failure);
    const std::unique_ptr<GError, decltype(&g_error_free)> error(failure, g_error_free);
    if (!started)
        op.error("%@ cannot be started: %s", app, error ? error->message : "");
    return started;
}

} // namespace host::system
