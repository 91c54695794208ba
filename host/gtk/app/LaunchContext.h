// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

typedef struct _GAppLaunchContext GAppLaunchContext;

namespace host::gtk {

/// What an app that is started now needs to bring its window to the front: the display, and a token that says
/// that the person asked for it. Null without a display. Main thread.
std::shared_ptr<GAppLaunchContext> makeLaunchContext();

} // namespace host::gtk
