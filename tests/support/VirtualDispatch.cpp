#include "tests/support/VirtualDispatch.h"

#include <algorithm>
#include <atomic>

namespace testing_support {

namespace {

using platform::Duration;
using platform::Work;

class VirtualQueue : public platform::Queue {
public:
    VirtualQueue(std::weak_ptr<VirtualDispatch> dispatch, std::string label)
        : _dispatch(std::move(dispatch))
        , _label(std::move(label))
    {
    }
    void async(Work work) override
    {
        if (const auto dispatch = _dispatch.lock())
            dispatch->submit(Duration::zero(), std::move(work));
    }
    const std::string& label() const override { return _label; }

private:
    std::weak_ptr<VirtualDispatch> _dispatch;
    std::string _label;
};

class VirtualOperationQueue : public platform::OperationQueue {
public:
    VirtualOperationQueue(
        std::weak_ptr<VirtualDispatch> dispatch, std::string name, platform::QualityOfService quality)
        : _queue(std::move(dispatch), std::move(name))
        , _quality(quality)
    {
    }
    void addOperation(Work work) override { _queue.async(std::move(work)); }
    const std::string& name() const override { return _queue.label(); }
    platform::QualityOfService qualityOfService() const override { return _quality; }

private:
    VirtualQueue _queue;
    platform::QualityOfService _quality;
};

struct VirtualTimerState {
    std::weak_ptr<VirtualDispatch> dispatch;
    Duration period;
    Work handler;
    std::atomic<bool> cancelled = false;
};

void fire(const std::shared_ptr<VirtualTimerState>& state)
{
    if (state->cancelled)
        return;
    if (const auto dispatch = state->dispatch.lock())
        dispatch->submit(state->period, [state] { fire(state); });
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
    auto queue = _mainQueue.lock();
    if (!queue) {
        queue = std::make_shared<VirtualQueue>(weak_from_this(), "main");
        _mainQueue = queue;
    }
    return queue;
}

std::shared_ptr<platform::Queue> VirtualDispatch::makeSerialQueue(std::string label)
{
    return std::make_shared<VirtualQueue>(weak_from_this(), std::move(label));
}

std::shared_ptr<platform::OperationQueue> VirtualDispatch::makeOperationQueue(
    std::string name, platform::QualityOfService quality)
{
    return std::make_shared<VirtualOperationQueue>(weak_from_this(), std::move(name), quality);
}

void VirtualDispatch::after(Duration delay, const std::shared_ptr<platform::Queue>&, Work work)
{
    submit(delay, std::move(work));
}

std::unique_ptr<platform::Timer> VirtualDispatch::startTimer(
    const std::shared_ptr<platform::Queue>&, Duration period, Duration, Work handler)
{
    auto state = std::make_shared<VirtualTimerState>();
    state->dispatch = weak_from_this();
    state->period = period;
    state->handler = std::move(handler);
    submit(Duration::zero(), [state] { fire(state); });
    return std::make_unique<VirtualTimer>(std::move(state));
}

platform::Date VirtualDispatch::now() const
{
    const std::lock_guard lock(_mutex);
    return {_now};
}

void VirtualDispatch::submit(Duration delay, Work work)
{
    const std::lock_guard lock(_mutex);
    _pending.push_back({_now + delay.count(), _nextOrder++, std::move(work)});
}

bool VirtualDispatch::runNext(std::int64_t limit)
{
    Work work;
    {
        const std::lock_guard lock(_mutex);
        const auto next = std::ranges::min_element(_pending, [](const Pending& a, const Pending& b) {
            return std::pair(a.due, a.order) < std::pair(b.due, b.order);
        });
        if (next == _pending.end() || next->due > limit)
            return false;
        _now = std::max(_now, next->due);
        work = std::move(next->work);
        _pending.erase(next);
    }
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

std::size_t VirtualDispatch::pendingCount() const
{
    const std::lock_guard lock(_mutex);
    return _pending.size();
}

} // namespace testing_support
