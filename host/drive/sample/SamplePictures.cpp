// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SamplePictures.h"

#include <cairo.h>
#include <gdk-pixbuf/gdk-pixbuf.h>

#include <array>
#include <cmath>
#include <memory>
#include <sstream>
#include <vector>

namespace host::drive::sample {

namespace {

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

void setInk(cairo_t* context, Ink ink, double alpha = 1)
{
    cairo_set_source_rgba(context, ink.red, ink.green, ink.blue, alpha);
}

struct Palette {
    Ink skyTop, skyBottom, sun, far, near, ground;
};

constexpr std::array<Palette, 6> palettes{{
    {{.36, .62, .90}, {.93, .96, 1}, {1, .96, .80}, {.55, .68, .80}, {.33, .52, .45}, {.42, .63, .32}},
    {{.29, .18, .42}, {.98, .62, .40}, {1, .86, .55}, {.47, .28, .48}, {.30, .18, .35}, {.20, .13, .25}},
    {{.20, .55, .75}, {.80, .93, .95}, {1, 1, .9}, {.45, .70, .78}, {.93, .84, .62}, {.97, .91, .74}},
    {{.55, .66, .78}, {.92, .94, .97}, {1, 1, 1}, {.72, .80, .88}, {.86, .91, .96}, {.97, .98, 1}},
    {{.95, .76, .52}, {1, .94, .80}, {1, .98, .85}, {.79, .62, .43}, {.62, .55, .28}, {.75, .66, .30}},
    {{.08, .12, .28}, {.25, .32, .52}, {.95, .95, .85}, {.15, .20, .38}, {.09, .13, .24}, {.05, .08, .15}},
}};

void fillSky(cairo_t* context, const Palette& palette, double width, double height)
{
    const std::unique_ptr<cairo_pattern_t, decltype(&cairo_pattern_destroy)> sky(
        cairo_pattern_create_linear(0, 0, 0, height), &cairo_pattern_destroy);
    cairo_pattern_add_color_stop_rgb(
        sky.get(), 0, palette.skyTop.red, palette.skyTop.green, palette.skyTop.blue);
    cairo_pattern_add_color_stop_rgb(
        sky.get(), .75, palette.skyBottom.red, palette.skyBottom.green, palette.skyBottom.blue);
    cairo_set_source(context, sky.get());
    cairo_rectangle(context, 0, 0, width, height);
    cairo_fill(context);
}

void fillCircle(cairo_t* context, double x, double y, double radius)
{
    cairo_arc(context, x, y, radius, 0, 2 * M_PI);
    cairo_fill(context);
}

// Answers the height of a range of hills, a sum of waves, so that no two variants look alike.
double hillTop(double x, double width, double height, double base, double swing, int variant)
{
    const double t = x / width * 2 * M_PI;
    return height
        * (base
            - swing
                * (std::sin(t * 1.3 + variant) + .5 * std::sin(t * 3.1 + 2.0 * variant)
                    + .22 * std::sin(t * 7.7 + 3.0 * variant)));
}

void fillHills(cairo_t* context, double width, double height, double base, double swing, int variant)
{
    constexpr int steps = 240;
    cairo_move_to(context, 0, height);
    for (int i = 0; i <= steps; ++i) {
        const double x = width * i / steps;
        cairo_line_to(context, x, hillTop(x, width, height, base, swing, variant));
    }
    cairo_line_to(context, width, height);
    cairo_close_path(context);
    cairo_fill(context);
}

void fillTree(cairo_t* context, double x, double y, double size)
{
    for (int tier = 0; tier < 3; ++tier) {
        const double top = y - size * (.45 + .28 * tier), half = size * (.26 - .06 * tier);
        cairo_move_to(context, x, top - size * .25);
        cairo_line_to(context, x - half, top + size * .2);
        cairo_line_to(context, x + half, top + size * .2);
        cairo_close_path(context);
        cairo_fill(context);
    }
    cairo_rectangle(context, x - size * .03, y - size * .3, size * .06, size * .3);
    cairo_fill(context);
}

void drawLandscape(cairo_t* context, double width, double height, int variant)
{
    const auto& palette = palettes[static_cast<std::size_t>(variant) % palettes.size()];
    fillSky(context, palette, width, height);
    const double sunX = width * (.2 + .12 * (variant % 6)), sunY = height * .28;
    setInk(context, palette.sun, .25);
    fillCircle(context, sunX, sunY, height * .12);
    setInk(context, palette.sun);
    fillCircle(context, sunX, sunY, height * .075);
    setInk(context, palette.far);
    fillHills(context, width, height, .58, .07, variant);
    setInk(context, palette.near);
    fillHills(context, width, height, .70, .05, variant + 5);
    setInk(context, {palette.near.red * .7, palette.near.green * .75, palette.near.blue * .7});
    for (int i = 0; i < 9; ++i) {
        const double x = width * (.06 + .11 * i + .02 * ((i * 7 + variant) % 5));
        const double foot = hillTop(x, width, height, .70, .05, variant + 5) + height * .02;
        fillTree(context, x, foot, height * (.12 + .02 * ((i + variant) % 4)));
    }
    setInk(context, palette.ground);
    fillHills(context, width, height, .86, .03, variant + 9);
}

GdkPixbuf* pixbufFrom(cairo_surface_t* surface)
{
    const int width = cairo_image_surface_get_width(surface),
              height = cairo_image_surface_get_height(surface);
    const int stride = cairo_image_surface_get_stride(surface);
    cairo_surface_flush(surface);
    const unsigned char* source = cairo_image_surface_get_data(surface);
    GdkPixbuf* pixbuf = gdk_pixbuf_new(GDK_COLORSPACE_RGB, FALSE, 8, width, height);
    guchar* target = gdk_pixbuf_get_pixels(pixbuf);
    const int targetStride = gdk_pixbuf_get_rowstride(pixbuf);
    for (int y = 0; y < height; ++y) {
        const auto* row =
            reinterpret_cast<const std::uint32_t*>(source + static_cast<std::ptrdiff_t>(y) * stride);
        guchar* out = target + static_cast<std::ptrdiff_t>(y) * targetStride;
        for (int x = 0; x < width; ++x, out += 3) {
            out[0] = static_cast<guchar>(row[x] >> 16);
            out[1] = static_cast<guchar>(row[x] >> 8);
            out[2] = static_cast<guchar>(row[x]);
        }
    }
    return pixbuf;
}

std::string encoded(cairo_surface_t* surface, const char* format, const char* option, const char* value)
{
    const std::unique_ptr<GdkPixbuf, decltype(&g_object_unref)> pixbuf(pixbufFrom(surface), &g_object_unref);
    gchar* bytes = nullptr;
    gsize size = 0;
    gdk_pixbuf_save_to_buffer(pixbuf.get(), &bytes, &size, format, nullptr, option, value, nullptr);
    const std::unique_ptr<gchar, decltype(&g_free)> owned(bytes, &g_free);
    return {bytes, size};
}

struct Picture {
    Picture(int width, int height)
        : surface(cairo_image_surface_create(CAIRO_FORMAT_RGB24, width, height))
        , context(cairo_create(surface.get()))
    {
    }
    std::string jpeg() const
    {
        flush();
        return encoded(surface.get(), "jpeg", "quality", "85");
    }
    std::string png() const
    {
        flush();
        return encoded(surface.get(), "png", "compression", "6");
    }
    void flush() const { cairo_surface_flush(surface.get()); }

    Surface surface;
    Context context;
};

} // namespace

std::string landscapeJpeg(int variant)
{
    const Picture picture(1600, 1200);
    drawLandscape(picture.context.get(), 1600, 1200, variant);
    return picture.jpeg();
}

std::string portraitPng(int variant)
{
    const Picture picture(900, 900);
    cairo_t* context = picture.context.get();
    constexpr Ink furs[] = {{.91, .62, .32}, {.45, .45, .50}, {.25, .22, .22}};
    const Ink fur = furs[variant % 3];
    setInk(context, {.96, .93, .87});
    cairo_paint(context);
    setInk(context, {.62, .36, .40});
    cairo_save(context);
    cairo_translate(context, 450, 760);
    cairo_scale(context, 1, .28);
    fillCircle(context, 0, 0, 380);
    cairo_restore(context);
    setInk(context, fur);
    cairo_save(context);
    cairo_translate(context, 450, 640);
    cairo_scale(context, 1, .8);
    fillCircle(context, 0, 0, 230);
    cairo_restore(context);
    fillCircle(context, 450, 380, 170);
    for (const int side : {-1, 1}) {
        cairo_move_to(context, 450 + side * 160, 360);
        cairo_line_to(context, 450 + side * 150, 150);
        cairo_line_to(context, 450 + side * 30, 240);
        cairo_close_path(context);
        cairo_fill(context);
    }
    for (const int side : {-1, 1}) {
        setInk(context, {.80, .90, .55});
        fillCircle(context, 450 + side * 65, 360, 30);
        setInk(context, {.08, .08, .08});
        fillCircle(context, 450 + side * 65, 360, 13);
    }
    setInk(context, {.85, .45, .50});
    fillCircle(context, 450, 425, 16);
    setInk(context, {.98, .98, .98});
    cairo_set_line_width(context, 4);
    for (const int side : {-1, 1}) {
        for (int i = -1; i <= 1; ++i) {
            cairo_move_to(context, 450 + side * 40, 435 + i * 8);
            cairo_line_to(context, 450 + side * 190, 430 + i * 34);
            cairo_stroke(context);
        }
    }
    return picture.png();
}

std::string windowShotPng()
{
    const Picture picture(1280, 800);
    cairo_t* context = picture.context.get();
    drawLandscape(context, 1280, 800, 1);
    setInk(context, {.98, .98, .98});
    cairo_rectangle(context, 220, 120, 840, 540);
    cairo_fill(context);
    setInk(context, {.90, .90, .91});
    cairo_rectangle(context, 220, 120, 840, 48);
    cairo_fill(context);
    constexpr Ink rows[] = {{.21, .52, .89}, {.20, .65, .43}, {.90, .38, .20}, {.57, .35, .72}};
    for (int i = 0; i < 8; ++i) {
        setInk(context, rows[i % 4], .85);
        cairo_rectangle(context, 250, 200 + i * 54, 34, 34);
        cairo_fill(context);
        setInk(context, {.35, .35, .37});
        cairo_rectangle(context, 306, 207 + i * 54, 200 + (i * 83) % 260, 8);
        cairo_fill(context);
        setInk(context, {.70, .70, .72});
        cairo_rectangle(context, 306, 223 + i * 54, 90 + (i * 37) % 90, 6);
        cairo_fill(context);
    }
    return picture.png();
}

std::string chartSvg()
{
    std::ostringstream svg;
    svg <<
        R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 640 400" width="640" height="400">
<rect width="640" height="400" fill="#ffffff"/>
<g font-family="sans-serif" font-size="14" fill="#3d3846">
<text x="320" y="34" font-size="20" text-anchor="middle">Sorting 1,000,000 numbers (ms)</text>
)";
    constexpr int values[] = {312, 148, 96, 64, 41};
    constexpr const char* names[] = {"bubble*", "heap", "merge", "quick", "radix"};
    constexpr const char* colours[] = {"#e66100", "#3584e4", "#33d17a", "#9141ac", "#f6d32d"};
    for (int i = 0; i < 5; ++i) {
        const int height = values[i] * 9 / 10;
        svg << R"(<rect x=")" << 70 + i * 110 << R"(" y=")" << 340 - height << R"(" width="70" height=")"
            << height << R"(" rx="6" fill=")" << colours[i] << R"("/>
<text x=")" << 105 + i * 110
            << R"(" y="364" text-anchor="middle">)" << names[i] << "</text>\n";
    }
    svg << R"(</g>
<line x1="50" y1="340" x2="610" y2="340" stroke="#3d3846"/>
</svg>
)";
    return svg.str();
}

std::string sketchSvg(int variant)
{
    std::string svg =
        R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 400 400" width="400" height="400">
<rect width="400" height="400" fill="#fdfaf3"/>
<g fill="none" stroke="#5e5c64" stroke-width="3" stroke-linecap="round">
)";
    for (int ring = 0; ring < 7; ++ring) {
        svg += "<path d=\"M";
        for (int step = 0; step <= 48; ++step) {
            const double angle = step * 2 * M_PI / 48;
            const double radius =
                30 + 22 * ring + (6 + variant) * std::sin(angle * (3 + variant) + ring * .6);
            svg += (step ? " L" : "") + std::to_string(200 + radius * std::cos(angle)) + " "
                + std::to_string(200 + radius * std::sin(angle));
        }
        svg += "\" opacity=\"" + std::to_string(1 - ring * .12) + "\"/>\n";
    }
    return svg + "</g>\n</svg>\n";
}

} // namespace host::drive::sample
