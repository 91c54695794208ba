// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace platform {

/// A place. All lengths in this file are points: of the interface, which has a pixel or more to each, or of
/// the page that a header names. x grows to the right and y grows downwards.
struct Point {
    double x = 0, y = 0;
    bool operator==(const Point&) const = default;
};

/// A width and a height, which nothing keeps from being negative.
struct Size {
    double width = 0, height = 0;
    bool operator==(const Size&) const = default;
};

/// A rectangle by its top left corner and its size. The functions below expect a size that is not negative.
struct Rect {
    double x = 0, y = 0, width = 0, height = 0;

    /// The right and the bottom edge, and the centre.
    double maxX() const { return x + width; }
    double maxY() const { return y + height; }
    double midX() const { return x + width / 2; }
    double midY() const { return y + height / 2; }
    Point origin() const { return {x, y}; }
    Size size() const { return {width, height}; }

    /// Whether a point lies inside. The left and top edges are inside and the right and bottom edges are
    /// outside, so that every point belongs to one of two rectangles side by side.
    bool contains(Point p) const { return p.x >= x && p.x < maxX() && p.y >= y && p.y < maxY(); }

    bool operator==(const Rect&) const = default;
};

/// Distances from the edges of a rectangle, counted inwards.
struct EdgeInsets {
    double top = 0, left = 0, bottom = 0, right = 0;
    bool operator==(const EdgeInsets&) const = default;
};

} // namespace platform
