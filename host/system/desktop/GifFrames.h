// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstddef>
#include <string_view>

namespace host::system {

/// Counts the frames of a GIF without decoding them; 0 for any other file. In a truncated file every frame
/// counts that begins.
std::size_t gifFrameCount(std::string_view bytes);

} // namespace host::system
