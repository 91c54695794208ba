// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cairo.h>

#include <memory>

namespace host::drive::sample {

struct DestroyContext {
    void operator()(cairo_t* context) const { cairo_destroy(context); }
};
struct DestroySurface {
    void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};
using Context = std::unique_ptr<cairo_t, DestroyContext>;
using Surface = std::unique_ptr<cairo_surface_t, DestroySurface>;

struct Ink {
    double red, green, blue;
};

inline void setInk(cairo_t* context, Ink ink, double alpha = 1)
{
    cairo_set_source_rgba(context, ink.red, ink.green, ink.blue, alpha);
}

} // namespace host::drive::sample
