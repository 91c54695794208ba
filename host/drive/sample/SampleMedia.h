// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <vector>

namespace host::drive::sample {

/// A short tune as uncompressed audio (WAV, 16 bits, one channel).
std::string tuneWav(int variant);

/// A film of JPEG pictures of one size (Motion JPEG in AVI), at `framesPerSecond`.
std::string motionJpegAvi(const std::vector<std::string>& frames, int width, int height, int framesPerSecond);

/// A few seconds of a sunrise over hills.
std::string sunriseAvi();

} // namespace host::drive::sample
