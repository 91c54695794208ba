// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/TapRecognizer.h"

#include <cmath>

namespace kit {

void TapRecognizer::pressed(Point point, Time time)
{
    if (isEnabled())
        _press = {point, time};
}

void TapRecognizer::moved(Point point, Time)
{
    if (_press && std::hypot(point.x - _press->point.x, point.y - _press->point.y) > maximumMovement)
        _press.reset();
}

void TapRecognizer::released(Point point, Time time)
{
    moved(point, time);
    const auto press = _press;
    _press.reset();
    if (press && time - press->time <= maximumDuration)
        recognized(point);
}

void TapRecognizer::cancelled()
{
    _press.reset();
}

} // namespace kit
