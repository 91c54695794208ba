// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Image.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <optional>

namespace screens {

/// The longer side of a row's thumbnail in pixels, which is 40 points at twice the resolution.
inline constexpr int rowThumbnailSide = 80;

/// Answers a small picture of a document with a darker edge, made when the desktop has none yet; nothing when
/// there is none. It decodes images, so call it off the main thread.
std::optional<Image> readRowThumbnail(const Url& url);

/// Answers an image whose longer side has at most so many pixels, with two pixels to a point. Each pixel is
/// the mean of those it replaces. An image that is small enough stays as it is.
Image scaledDown(const Image& image, int side);

} // namespace screens
