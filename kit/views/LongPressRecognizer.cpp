// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/LongPressRecognizer.h"

#include <cmath>

namespace kit {

void LongPressRecognizer::pressed(Point point, Time time)
{
    if (isEnabled())
        _press = {point, time};
}

void LongPressRecognizer::moved(Point point, Time time)
{
    if (_press && std::hypot(point.x - _press->point.x, point.y - _press->point.y) > maximumMovement)
        _press.reset();
    held(time);
}

void LongPressRecognizer::held(Time time)
{
    if (!_press || time - _press->time < minimumDuration)
        return;
    const Point point = _press->point;
    _press.reset();
    recognized(point);
}

void LongPressRecognizer::released(Point point, Time time)
{
    moved(point, time);
    _press.reset();
}

void LongPressRecognizer::cancelled()
{
    _press.reset();
}

} // namespace kit
