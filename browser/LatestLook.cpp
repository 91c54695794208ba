// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/LatestLook.h"

#include "platform/Services.h"
#include "platform/Weakly.h"

namespace tarrow {

using platform::services;
using platform::weakly;

void LatestLook::start(platform::Work look, std::function<void()> then, std::function<void()> dropped)
{
    forget();
    _then = std::move(then);
    _dropped = std::move(dropped);
    if (!_queue)
        _queue = services().dispatch().makeOperationQueue("looks", platform::QualityOfService::UserInitiated);
    _queue->addOperation([look = std::move(look), ended = weakly(this, &LatestLook::lookEnded, _number),
                             main = services().dispatch().mainQueue()] {
        look();
        main->async(ended);
    });
}

void LatestLook::lookEnded(std::size_t number)
{
    if (number != _number)
        return;
    ++_number;
    _dropped = {};
    if (const auto then = std::exchange(_then, {}))
        then();
}

void LatestLook::forget()
{
    ++_number;
    _then = {};
    if (const auto dropped = std::exchange(_dropped, {}))
        dropped();
}

} // namespace tarrow
