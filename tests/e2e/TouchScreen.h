// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "Accessible.h"

#include <cstdint>
#include <string>
#include <vector>

namespace e2e {

/// The touch screen of a test's X server. Its touches reach the program like those of a real one. Each call
/// returns once the server has passed the event on.
class TouchScreen {
public:
    /// `path` is that of the server's touch device. `width` and `height` are the display's.
    TouchScreen(const std::string& path, double width, double height);
    ~TouchScreen();
    TouchScreen(const TouchScreen&) = delete;
    TouchScreen& operator=(const TouchScreen&) = delete;

    bool isConnected() const { return _socket >= 0; }
    void put(unsigned finger, Place place);
    void move(unsigned finger, Place place);
    void lift(unsigned finger);

    void tap(Place place);
    /// Puts one finger down for each path and moves all of them at once, each from its first place to its
    /// second. The fingers stay down.
    struct Path {
        Place from, to;
    };
    void draw(const std::vector<Path>& paths, int milliseconds = 200);
    void liftAll();
    /// Moves a finger and lifts it. A drag rests at its last place before; a flick is lifted in full
    /// movement.
    void drag(Path path, int milliseconds = 200);
    void flick(Path path);

private:
    void send(unsigned finger, std::uint16_t type, Place place);

    int _socket = -1;
    double _width, _height;
    std::vector<Place> _fingers; ///< the last place of each finger
    std::vector<unsigned> _down;
};

} // namespace e2e
