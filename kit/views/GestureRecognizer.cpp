// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/GestureRecognizer.h"

#include <utility>

namespace kit {

GestureRecognizer::GestureRecognizer(Handler handler)
    : _handler(std::move(handler))
{
}

void GestureRecognizer::setEnabled(bool enabled)
{
    _enabled = enabled;
    if (!enabled)
        cancelled();
}

void GestureRecognizer::recognized(Point point) const
{
    // The handler may destroy the view that owns this recogniser.
    const auto handler = _handler;
    if (_enabled && handler)
        handler(point);
}

} // namespace kit
