// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/LatestLook.h"

#include "platform/Services.h"
#include "platform/Weakly.h"

#include <chrono>
#include <future>

namespace platform {

namespace {

/// The main thread waits no longer than this, a frame at most.
constexpr auto shortWait = std::chrono::milliseconds(16);

} // namespace

void LatestLook::start(Work look, std::function<void()> then, std::function<void()> dropped)
{
    forget();
    _then = std::move(then);
    _dropped = std::move(dropped);
    if (!_queue)
        _queue = services().dispatch().makeOperationQueue("looks", QualityOfService::UserInitiated);
    const auto number = _number;
    const auto hasLooked = std::make_shared<std::promise<void>>();
    _queue->addOperation(
        [look = std::move(look), hasLooked, ended = weakly(this, &LatestLook::lookEnded, number),
            main = services().dispatch().mainQueue()] {
            look();
            hasLooked->set_value();
            main->async(ended);
        });
    // A disk that is not slow answers within the wait, and the keys that come next find what was asked for.
    if (hasLooked->get_future().wait_for(shortWait) == std::future_status::ready)
        lookEnded(number);
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

} // namespace platform
