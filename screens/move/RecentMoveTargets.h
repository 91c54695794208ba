// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <cstddef>
#include <vector>

namespace screens {

/// The folders to which items were last moved, the latest one first, kept between runs. They may have been
/// deleted since. Main thread only.
class RecentMoveTargets {
public:
    static constexpr std::size_t kept = 8; ///< more than are shown, because some of them do not fit a move

    static std::vector<Url> folders();
    static void remember(const Url& folder);
};

} // namespace screens
