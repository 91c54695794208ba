// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace tarrow {

// TarrowDriveAppPreview: the question that a preview asks about a location.

/// Answers whether sounds and films at this location play in the standard player. It is always true.
inline bool wantsDefaultMediaPlayer(const platform::Url&)
{
    return true;
}

} // namespace tarrow
