// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "TouchScreen.h"

#include <gtest/gtest.h>
#include <xorg/xf86-input-inputtest-protocol.h>

#include <algorithm>
#include <chrono>
#include <sys/socket.h>
#include <sys/un.h>
#include <thread>
#include <unistd.h>

namespace e2e {

namespace {

constexpr std::uint16_t begin = 18, update = 19, end = 20; ///< event types of X's input driver
constexpr double axisLength = 65535; ///< length of the driver's axes for the whole display
constexpr int step = 10; ///< milliseconds between two reports of a finger, as on a real touch screen
constexpr int restSteps =
    12; ///< a finger rests so long before it is lifted, so that the content does not go on moving

template <typename Event>
bool write(int socket, Event& event, std::uint32_t type)
{
    event.header = {sizeof event, static_cast<xf86ITEventType>(type)};
    return ::write(socket, &event, sizeof event) == sizeof event;
}

template <typename Response>
bool read(int socket)
{
    Response response;
    return ::recv(socket, &response, sizeof response, MSG_WAITALL) == sizeof response;
}

/// Waits in real time, because the program measures the times of touches.
void pass(int milliseconds)
{
    std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
}

} // namespace

TouchScreen::TouchScreen(const std::string& path, double width, double height)
    : _socket(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0))
    , _width(width)
    , _height(height)
    , _fingers(10)
{
    sockaddr_un address{AF_UNIX, {}};
    path.copy(address.sun_path, sizeof address.sun_path - 1);
    xf86ITEventClientVersion version{{}, XF86IT_PROTOCOL_VERSION_MAJOR, XF86IT_PROTOCOL_VERSION_MINOR};
    if (connect(_socket, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0
        && write(_socket, version, XF86IT_EVENT_CLIENT_VERSION) && read<xf86ITResponseServerVersion>(_socket))
        return;
    close(_socket);
    _socket = -1;
}

TouchScreen::~TouchScreen()
{
    if (!isConnected())
        return;
    liftAll();
    close(_socket);
}

void TouchScreen::send(unsigned finger, std::uint16_t type, Place place)
{
    _fingers[finger] = place;
    xf86ITEventTouch event{};
    event.touchid = finger;
    event.touch_type = type;
    event.valuators.mask[0] = 0b11;
    event.valuators.valuators[0] = place.x / _width * axisLength;
    event.valuators.valuators[1] = place.y / _height * axisLength;
    EXPECT_TRUE(write(_socket, event, XF86IT_EVENT_TOUCH));
    xf86ITEventWaitForSync sync{};
    EXPECT_TRUE(
        write(_socket, sync, XF86IT_EVENT_WAIT_FOR_SYNC) && read<xf86ITResponseSyncFinished>(_socket));
}

void TouchScreen::put(unsigned finger, Place place)
{
    _down.push_back(finger);
    send(finger, begin, place);
}

void TouchScreen::move(unsigned finger, Place place)
{
    send(finger, update, place);
}

void TouchScreen::lift(unsigned finger)
{
    std::erase(_down, finger);
    send(finger, end, _fingers[finger]);
}

void TouchScreen::liftAll()
{
    while (!_down.empty())
        lift(_down.back());
}

void TouchScreen::tap(Place place)
{
    put(0, place);
    pass(step);
    lift(0);
}

void TouchScreen::draw(const std::vector<Path>& paths, int milliseconds)
{
    for (unsigned i = 0; i < paths.size(); ++i)
        put(i, paths[i].from);
    const int steps = milliseconds / step;
    for (int done = 1; done <= steps; ++done) {
        pass(step);
        const double part = static_cast<double>(done) / steps;
        for (unsigned i = 0; i < paths.size(); ++i) {
            const auto& [from, to] = paths[i];
            move(i, {from.x + (to.x - from.x) * part, from.y + (to.y - from.y) * part});
        }
    }
}

void TouchScreen::drag(Path path, int milliseconds)
{
    draw({path}, milliseconds);
    for (int i = 0; i < restSteps; ++i) {
        pass(step);
        move(0, path.to);
    }
    lift(0);
}

void TouchScreen::flick(Path path)
{
    draw({path}, 60);
    lift(0);
}

} // namespace e2e
