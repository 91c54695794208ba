// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/LaunchContext.h"

#include <gdk/gdk.h>

namespace host::gtk {

std::shared_ptr<GAppLaunchContext> makeLaunchContext()
{
    auto* display = gdk_display_get_default();
    if (!display)
        return nullptr;
    return {G_APP_LAUNCH_CONTEXT(gdk_display_get_app_launch_context(display)),
        [](GAppLaunchContext* context) { g_object_unref(context); }};
}

} // namespace host::gtk
