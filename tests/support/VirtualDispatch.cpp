// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/VirtualDispatch.h"

#include <algorithm>
#include <atomic>

namespace testing_support {

namespace {

using namespace platform;

/// A queue of either kind, because all work runs on one thread.
class VirtualQueue : public platform::Queue,
                     public platform::OperationQueue,
                     public std::enable_shared_from_this<VirtualQueue> {
public:
    VirtualQueue(std::weak_ptr<VirtualDispatch> dispatch, std::string label,
        platform::QualityOfService quality = platform::QualityOfService::UserInteractive)
        : _dispatch(std::move(dispatch))
        , _label(std::move(label))
        , _quality(quality)
    {
    }
    void async(Work work) override
    {
        if (const auto dispatch = _dispatch.lock())
            dispatch->submit(Duration::zero(), weak_from_this(), std::move(work));
    }
    void addOperation(Work work) override { async(std::move(work)); }
    const std::string& label() const override { return _label; }
    const std::string& name() const override { return _label; }
    platform::QualityOfService qualityOfService() const override { return _quality; }

private:
    std::weak_ptr<VirtualDispatch> _dispatch;
    std::string _label;
    platform::QualityOfService _quality;
};

struct VirtualTimerState {
    std::weak_ptr<VirtualDispatch> dispatch;
    std::shared_ptr<platform::Queue> queue;
    Duration period;
    Work handler;
    std::atomic<bool> cancelled = false;
};

void fire(const std::shared_ptr<VirtualTimerState>& state)
{
    if (state->cancelled)
        return;
    if (const auto dispatch = state->dispatch.lock())
        dispatch->submit(state->period, state, [weak = std::weak_ptr(state)] { fire(weak.lock()); });
    state->handler();
}

class VirtualTimer : public platform::Timer {
public:
    explicit VirtualTimer(std::shared_ptr<VirtualTimerState> state)
        : _state(std::move(state))
    {
    }
    ~VirtualTimer() override { _state->cancelled = true; }
    void cancel() override { _state->cancelled = true; }

private:
    std::shared_ptr<VirtualTimerState> _state;
};

} // namespace

std::shared_ptr<platform::Queue> VirtualDispatch::mainQueue()
{
    const std::lock_guard lock(_mutex);
    if (!_mainQueue)
        _mainQueue = std::make_shared<VirtualQueue>(weak_from_this(), "main");
    return _mainQueue;
}

std::shared_ptr<platform::Queue> VirtualDispatch::makeSerialQueue(std::string label)
{
    return std::make_shared<VirtualQueue>(weak_from_this(), std::move(label));
}

std::shared_ptr<platform::OperationQueue> VirtualDispatch::makeOperationQueue(
    std::string name, platform::QualityOfService quality)
{
    return std::make_shared<VirtualQueue>(weak_from_this(), std::move(name), quality);
}

void VirtualDispatch::after(Duration delay, const std::shared_ptr<platform::Queue>& queue, Work work)
{
    // The delay keeps the queue alive, as the host's does.
    submit(delay, weak_from_this(), [queue, work = std::move(work)] { work(); });
}

std::unique_ptr<platform::Timer> VirtualDispatch::startTimer(
    const std::shared_ptr<platform::Queue>& queue, Duration period, Duration, Work handler)
{
    auto state = std::make_shared<VirtualTimerState>();
    state->dispatch = weak_from_this();
    state->queue = queue;
    state->period = period;
    state->handler = std::move(handler);
    submit(Duration::zero(), state, [weak = std::weak_ptr(state)] { fire(weak.lock()); });
    return std::make_unique<VirtualTimer>(std::move(state));
}

platform::Date VirtualDispatch::now() const
{
    const std::lock_guard lock(_mutex);
    return {_now};
}

void VirtualDispatch::submit(Duration delay, std::weak_ptr<const void> queue, Work work)
{
    const std::lock_guard lock(_mutex);
    if (_hasEnded)
        return;
    _pending.push_back({_now + delay.count(), _nextOrder++, std::move(queue), std::move(work)});
}

bool VirtualDispatch::runNext(std::int64_t limit)
{
    Work work;
    std::shared_ptr<const void> queue;
    {
        const std::lock_guard lock(_mutex);
        const auto next = std::ranges::min_element(_pending, [](const Pending& a, const Pending& b) {
            return std::pair(a.due, a.order) < std::pair(b.due, b.order);
        });
        if (next == _pending.end() || next->due > limit)
            return false;
        _now = std::max(_now, next->due);
        work = std::move(next->work);
        queue = next->queue.lock();
        _pending.erase(next);
    }
    if (queue)
        work();
    return true;
}

void VirtualDispatch::runUntilIdle()
{
    while (runNext(now().nanoseconds)) { }
}

void VirtualDispatch::advance(double seconds)
{
    const auto end = now().nanoseconds + static_cast<std::int64_t>(seconds * 1e9);
    while (runNext(end)) { }
    const std::lock_guard lock(_mutex);
    _now = end;
}

void VirtualDispatch::end()
{
    // The dropped work is destroyed outside the lock, because it may add work while it is destroyed.
    std::vector<Pending> dropped;
    {
        const std::lock_guard lock(_mutex);
        _hasEnded = true;
        dropped.swap(_pending);
    }
}

std::size_t VirtualDispatch::pendingCount() const
{
    const std::lock_guard lock(_mutex);
    return static_cast<std::size_t>(
        std::ranges::count_if(_pending, [](const Pending& pending) { return !pending.queue.expired(); }));
}

} // namespace testing_support
