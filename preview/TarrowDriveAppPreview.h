// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace tarrow {

// TarrowDriveAppPreview: what a preview asks a location.

/// Whether sounds and films at this location play in the standard player: always.
inline bool wantsDefaultMediaPlayer(const platform::Url&)
{
    return true;
}

} // namespace tarrow
