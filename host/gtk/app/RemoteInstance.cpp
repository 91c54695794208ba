// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/RemoteInstance.h"

#include "host/gtk/base/ObjectRef.h"
#include "platform/UserActivity.h"

#include <gio/gio.h>

#include <algorithm>

namespace host::gtk {

namespace {

constexpr int callTimeout = 5000; ///< milliseconds

bool hasOwner(GDBusConnection* bus, const std::string& name)
{
    auto* answer = g_dbus_connection_call_sync(bus, "org.freedesktop.DBus", "/org/freedesktop/DBus",
        "org.freedesktop.DBus", "NameHasOwner", g_variant_new("(s)", name.c_str()), G_VARIANT_TYPE("(b)"),
        G_DBUS_CALL_FLAGS_NONE, callTimeout, nullptr, nullptr);
    if (!answer)
        return false;
    gboolean owned = FALSE;
    g_variant_get(answer, "(b)", &owned);
    g_variant_unref(answer);
    return owned;
}

/// Answers the launcher's data, with which the window may come to the front.
GVariant* platformData()
{
    GVariantBuilder builder;
    g_variant_builder_init(&builder, G_VARIANT_TYPE_VARDICT);
    if (const char* token = g_getenv("DESKTOP_STARTUP_ID"))
        g_variant_builder_add(&builder, "{sv}", "desktop-startup-id", g_variant_new_string(token));
    if (const char* token = g_getenv("XDG_ACTIVATION_TOKEN"))
        g_variant_builder_add(&builder, "{sv}", "activation-token", g_variant_new_string(token));
    return g_variant_builder_end(&builder);
}

GVariant* queryActivity(const std::string& query)
{
    GVariantBuilder builder;
    g_variant_builder_init(&builder, G_VARIANT_TYPE_VARDICT);
    const std::string type(platform::activityType::queryContinuation);
    const std::string key(platform::activityKey::searchQuery);
    g_variant_builder_add(&builder, "{sv}", "type", g_variant_new_string(type.c_str()));
    g_variant_builder_add(&builder, "{sv}", key.c_str(), g_variant_new_string(query.c_str()));
    return g_variant_builder_end(&builder);
}

/// Answers the arguments of ActivateAction: the action, its parameter if any, and the platform data.
GVariant* actionCall(const LaunchRequest& request)
{
    GVariantBuilder parameters;
    g_variant_builder_init(&parameters, G_VARIANT_TYPE("av"));
    const char* action = ActionNames::openUrl;
    const auto add = [&](GVariant* parameter) { g_variant_builder_add(&parameters, "v", parameter); };
    if (std::holds_alternative<OpenRecentDocument>(request)) {
        action = ActionNames::recentDocument;
    } else if (const auto* open = std::get_if<OpenUrl>(&request)) {
        add(g_variant_new_string(open->url.c_str()));
    } else if (const auto& query = std::get<OpenSearch>(request).query) {
        action = ActionNames::continueActivity;
        add(queryActivity(*query));
    } else {
        action = ActionNames::search;
    }
    return g_variant_new("(sav@a{sv})", action, &parameters, platformData());
}

} // namespace

RemoteInstance::RemoteInstance(std::string applicationId)
    : _applicationId(std::move(applicationId))
{
}

bool RemoteInstance::forward(const std::vector<LaunchRequest>& requests) const
{
    const auto bus = ObjectRef<GDBusConnection>::adopt(g_bus_get_sync(G_BUS_TYPE_SESSION, nullptr, nullptr));
    if (!bus || !hasOwner(bus.get(), _applicationId))
        return false;
    std::string path = "/" + _applicationId;
    std::ranges::replace(path, '.', '/');
    const auto call = [&](const char* method, GVariant* arguments) {
        auto* answer = g_dbus_connection_call_sync(bus.get(), _applicationId.c_str(), path.c_str(),
            "org.freedesktop.Application", method, arguments, nullptr, G_DBUS_CALL_FLAGS_NONE, callTimeout,
            nullptr, nullptr);
        if (answer)
            g_variant_unref(answer);
        return answer != nullptr;
    };
    if (!call("Activate", g_variant_new("(@a{sv})", platformData())))
        return false;
    for (const auto& request : requests)
        call("ActivateAction", actionCall(request));
    return true;
}

} // namespace host::gtk
