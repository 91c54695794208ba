// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <functional>

namespace tarrow {

/// What the menu of a quick preview does with its document, beside what the buttons in the bar do. The
/// functions run on the main thread. What has no function is not offered.
struct PreviewVerbs {
    using Verb = std::function<void(const platform::Url& document)>;
    Verb share, rename, showInfo, moveToTrash;
};

} // namespace tarrow
