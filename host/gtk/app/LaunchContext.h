// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

// NOLINTNEXTLINE(bugprone-reserved-identifier): the library's name
using GAppLaunchContext = struct _GAppLaunchContext;

namespace host::gtk {

/// Answers the context with which an app can bring its window to the front: the display, and a token for the
/// user's request. Answers null without a display. Main thread.
std::shared_ptr<GAppLaunchContext> makeLaunchContext();

} // namespace host::gtk
