// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Image.h"

#include <gdk-pixbuf/gdk-pixbuf.h>

#include <memory>

namespace host::system {

/// Gives back a reference to an object of GObject.
struct UnrefObject {
    void operator()(gpointer object) const { g_object_unref(object); }
};

using Pixbuf = std::unique_ptr<GdkPixbuf, UnrefObject>;

/// Answers a copy of a picture's pixels as an image of this scale (pixels per point). Any thread.
platform::Image imageOf(const GdkPixbuf* pixbuf, double scale);

/// Answers a copy of an image's pixels as a picture that a library can write; null for an image without any.
/// Any thread.
Pixbuf pixbufOf(const platform::Image& image);

} // namespace host::system
