// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/AlertAction.h"

namespace kit {

AlertAction::AlertAction(std::string title, AlertActionStyle style, Handler handler)
    : _title(std::move(title))
    , _style(style)
    , _handler(std::move(handler))
{
}

void AlertAction::setEnabled(bool enabled)
{
    if (enabled == _enabled)
        return;
    _enabled = enabled;
    if (_onChange)
        _onChange();
}

void AlertAction::run()
{
    if (const auto handler = _handler)
        handler(shared_from_this());
}

} // namespace kit
