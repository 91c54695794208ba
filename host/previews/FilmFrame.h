// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Image.h"

#include <string>

namespace host::previews {

/// Answers a frame from the beginning of the film in a file: a tenth of its length in, because many films
/// begin with black. Its longer side has at most so many pixels. It is turned as the camera was held. Errors
/// as those of platform::ThumbnailMaker. Any thread; it blocks for five seconds at most, apart from a decoder
/// that does not stop.
platform::Result<platform::Image> frameOfFilm(const std::string& path, int pixelSize);

} // namespace host::previews
