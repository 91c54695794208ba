// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"
#include "platform/Image.h"

#include <functional>
#include <memory>

namespace kit {

class Canvas;

/// A surface beside every window, whose drawing becomes an image. It is transparent at first. Colours are
/// drawn as they are, because no window's theme is known here; for the same reason a named icon is not drawn,
/// and texts have the system's plain typeface. A context belongs to the thread that opened it, and any thread
/// may open one.
class ImageContext {
public:
    virtual ~ImageContext() = default;

    /// Answers the surface, with the image's top left corner at (0, 0). It lives as long as the context.
    virtual Canvas& canvas() = 0;
    /// Answers a copy of what has been drawn so far.
    virtual Image image() = 0;

    /// Opens a context for an image of `size` points, with `scale` pixels to a point; a part of a pixel
    /// counts as a whole one. Answers null for an image without a pixel or with sides of more than 32767
    /// pixels, and where no host has installed the service.
    static std::unique_ptr<ImageContext> open(const Size& size, double scale);

    using Opener = std::function<std::unique_ptr<ImageContext>(const Size& size, double scale)>;
    /// Installs the service; null: none. It must be called while nobody opens a context.
    static void install(Opener opener);
};

} // namespace kit
