// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/MediaSupport.h"

#include "platform/Dispatch.h"
#include "platform/Localization.h"
#include "platform/Services.h"

#include <gst/gst.h>
#include <gtk/gtk.h>

#include <memory>
#include <utility>

namespace host::previews::MediaSupport {

namespace {

/// Answers whether the player's parts exist. The toolkit's player aborts the process when this part is
/// missing.
bool hasPlayer()
{
    if (!gst_init_check(nullptr, nullptr, nullptr))
        return false;
    auto* factory = gst_element_factory_find("playbin");
    if (factory)
        gst_object_unref(factory);
    return factory != nullptr;
}

/// Answers whether the toolkit's media module is installed. Without it the toolkit uses a stand-in that plays
/// nothing.
bool hasToolkitModule()
{
    auto* extensions = g_io_extension_point_lookup("gtk-media-file");
    if (!extensions)
        return false;
    auto* first = g_io_extension_point_get_extensions(extensions);
    return first
        && std::string(g_io_extension_get_name(static_cast<GIOExtension*>(first->data))) != "nomedia";
}

} // namespace

void check(std::function<void(const std::string& missing)> answer)
{
    auto& dispatch = platform::services().dispatch();
    const auto queue = dispatch.makeSerialQueue("media player");
    queue->async([queue, answer = std::move(answer), main = dispatch.mainQueue()] {
        const bool isThere = hasPlayer();
        main->async([queue, answer, isThere] {
            answer(isThere && hasToolkitModule() ? std::string()
                                                 : platform::localized("This computer has no media player."));
        });
    });
}

std::string wordsFor(const char* domain, int code)
{
    const std::string_view kind(domain);
    if (kind == g_quark_to_string(GST_CORE_ERROR) && code == GST_CORE_ERROR_MISSING_PLUGIN)
        return platform::localized("This computer cannot play this kind of recording.");
    if (kind == g_quark_to_string(GST_STREAM_ERROR)
        && (code == GST_STREAM_ERROR_CODEC_NOT_FOUND || code == GST_STREAM_ERROR_WRONG_TYPE))
        return platform::localized("This computer cannot play this kind of recording.");
    return platform::localized("The recording is damaged.");
}

} // namespace host::previews::MediaSupport
