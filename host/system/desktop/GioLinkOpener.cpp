// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GioLinkOpener.h"

#include "host/system/texts/Translate.h"
#include "platform/Dispatch.h"
#include "platform/Services.h"

#include <gio/gio.h>

#include <memory>
#include <utility>

namespace host::system {

using platform::Error;

namespace {

bool isWebPage(const std::string& url)
{
    const std::unique_ptr<char, decltype(&g_free)> scheme(g_uri_parse_scheme(url.c_str()), g_free);
    return scheme
        && (g_ascii_strcasecmp(scheme.get(), "https") == 0 || g_ascii_strcasecmp(scheme.get(), "http") == 0);
}

Error launchError(const GError& error)
{
    return {platform::errorDomain::system, error.code,
        {{std::string(platform::errorKey::localizedDescription),
             translated("No web browser could be started to open the page.")},
            {std::string(platform::errorKey::localizedFailureReason), std::string(error.message)}}};
}

void launched(GObject*, GAsyncResult* result, gpointer data)
{
    const std::unique_ptr<platform::LinkOpener::Completion> completion(
        static_cast<platform::LinkOpener::Completion*>(data));
    GError* failure = nullptr;
    g_app_info_launch_default_for_uri_finish(result, &failure);
    const std::unique_ptr<GError, decltype(&g_error_free)> owned(failure, g_error_free);
    (*completion)(owned ? std::optional(launchError(*owned)) : std::nullopt);
}

} // namespace

void GioLinkOpener::openLink(const std::string& url, Completion completion)
{
    if (isWebPage(url)) {
        auto kept = std::make_unique<Completion>(std::move(completion));
        g_app_info_launch_default_for_uri_async(url.c_str(), nullptr, nullptr, launched, kept.release());
        return;
    }
    platform::services().dispatch().mainQueue()->async(
        [completion = std::move(completion)] { completion(Error(platform::FileErrorCode::Unsupported)); });
}

} // namespace host::system
