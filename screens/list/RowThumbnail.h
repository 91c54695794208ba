// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Image.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <optional>

namespace screens {

/// The longer side of a row's thumbnail in pixels: 40 points at twice the resolution.
inline constexpr int rowThumbnailSide = 80;

/// A small picture of a document from the shared thumbnails; one of a picture that has none is made. Decodes
/// pictures: off the main thread. Nothing when there is none.
std::optional<Image> readRowThumbnail(const Url& url);

/// A picture made smaller so that its longer side has a number of pixels, each the mean of those it stands
/// for, with two pixels to a point; one that is small enough stays as it is.
Image scaledDown(const Image& image, int side);

} // namespace screens
