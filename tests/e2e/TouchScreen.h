// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "Accessible.h"

#include <cstdint>
#include <string>
#include <vector>

namespace e2e {

/// The touch screen of an X server of the tests: what its fingers do reaches the program as from a real one.
/// Each call returns once the server has passed the event on.
class TouchScreen {
public:
    /// `socket`: of the server's touch device. `width`, `height`: of its display.
    TouchScreen(const std::string& socket, double width, double height);
    ~TouchScreen();
    TouchScreen(const TouchScreen&) = delete;
    TouchScreen& operator=(const TouchScreen&) = delete;

    bool isConnected() const { return _socket >= 0; }
    void put(unsigned finger, Place place);
    void move(unsigned finger, Place place);
    void lift(unsigned finger);

    void tap(Place place);
    /// Puts one finger down for each path and draws them along at once, each from its first place to its
    /// second. They stay down.
    struct Path {
        Place from, to;
    };
    void draw(const std::vector<Path>& paths, int milliseconds = 200);
    void liftAll();
    /// A finger that draws and leaves the screen: at its last place, or, when it flicks, in full movement.
    void drag(Path path, int milliseconds = 200);
    void flick(Path path);

private:
    void send(unsigned finger, std::uint16_t type, Place place);

    int _socket = -1;
    double _width, _height;
    std::vector<Place> _fingers; ///< where each was last
    std::vector<unsigned> _down;
};

} // namespace e2e
