// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/RunningChanges.h"

#include "platform/Localization.h"
#include "platform/Weakly.h"

namespace tarrow {

using platform::localized;
using platform::weakly;

namespace {

constexpr auto period = std::chrono::milliseconds(100);
constexpr auto leeway = std::chrono::milliseconds(20);

} // namespace

/// Most changes end at once, and a line that flashes would disturb.
bool RunningChanges::isLong(const Date& since)
{
    return services().dispatch().now().nanoseconds - since.nanoseconds
        >= platform::Duration(longTime).count();
}

std::shared_ptr<RunningChanges> RunningChanges::create(
    std::function<void()> changed, std::function<void()> progressed)
{
    auto made = std::make_shared<RunningChanges>();
    made->_changed = std::move(changed);
    made->_progressed = std::move(progressed);
    return made;
}

void RunningChanges::begun(const std::shared_ptr<ItemChange>& change)
{
    _running.push_back({change, services().dispatch().now()});
    _changed();
    auto& dispatch = services().dispatch();
    dispatch.after(longTime, dispatch.mainQueue(), weakly(this, &RunningChanges::follow));
}

void RunningChanges::follow()
{
    if (_running.empty() || _timer)
        return;
    auto& dispatch = services().dispatch();
    _timer = dispatch.startTimer(
        dispatch.mainQueue(), period, leeway, weakly(this, [](RunningChanges& self) { self._progressed(); }));
}

void RunningChanges::forgetEnded()
{
    std::erase_if(_running, [](const Running& running) { return running.change->hasEnded(); });
    if (_running.empty())
        _timer = nullptr;
    _changed();
}

std::vector<Url> RunningChanges::items() const
{
    std::vector<Url> items;
    for (const auto& running : _running)
        items.insert(items.end(), running.change->items().begin(), running.change->items().end());
    return items;
}

std::shared_ptr<ItemChange> RunningChanges::longOne() const
{
    return !_running.empty() && isLong(_running.front().since) ? _running.front().change : nullptr;
}

std::string RunningChanges::progressText(const ItemChange& change)
{
    if (change.isCancelled())
        return localized("Cancelling…");
    const auto count = change.count();
    if (count < 2)
        return localized("Changing…");
    return localized(
        "%1$d of %2$d", {static_cast<std::int64_t>(change.doneCount()), static_cast<std::int64_t>(count)});
}

} // namespace tarrow
