// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/GLibDispatch.h"

#include "host/system/queues/PoolQueues.h"
#include "host/system/queues/Scheduler.h"
#include "host/system/queues/WorkerPool.h"
#include "platform/Weakly.h"

#include <glib.h>

#include <algorithm>
#include <atomic>
#include <thread>

namespace host::system {

using platform::Duration;
using platform::QualityOfService;
using platform::Queue;
using platform::weakly;
using platform::Work;

namespace {

// Work on serial queues may wait for the disk, and a few blocked queues must not hold up the others.
constexpr std::size_t serialThreads = 16;

std::size_t threadsFor(QualityOfService quality)
{
    const std::size_t cores = std::max(2U, std::thread::hardware_concurrency());
    return quality == QualityOfService::UserInitiated ? 2 * cores : cores;
}

/// A timer's state. The scheduler refers to it weakly and a call that waits in the queue strongly, so that
/// destroying the timer destroys its handler.
class TimerState : public std::enable_shared_from_this<TimerState> {
public:
    TimerState(std::weak_ptr<Scheduler> scheduler, std::shared_ptr<Queue> queue, Duration period,
        Duration leeway, Work handler)
        : _scheduler(std::move(scheduler))
        , _queue(std::move(queue))
        , _period(std::max(period, Duration(std::chrono::milliseconds(1))))
        , _leeway(leeway)
        , _handler(std::move(handler))
    {
    }

    void start()
    {
        callOnQueue();
        scheduleNext();
    }
    void cancel() { _cancelled = true; }

private:
    void scheduleNext()
    {
        _due += std::chrono::duration_cast<Scheduler::Clock::duration>(_period);
        // Calls that were missed while the machine slept or the thread was held up are left out.
        _due = std::max(_due, Scheduler::Clock::now());
        if (const auto scheduler = _scheduler.lock())
            scheduler->schedule(_due, _leeway, weakly(this, &TimerState::fire));
    }

    void fire()
    {
        if (_cancelled)
            return;
        callOnQueue();
        scheduleNext();
    }

    void callOnQueue()
    {
        if (_waits.exchange(true))
            return;
        _queue->async([self = shared_from_this()] {
            self->_waits = false;
            if (!self->_cancelled)
                self->_handler();
        });
    }

    const std::weak_ptr<Scheduler> _scheduler;
    const std::shared_ptr<Queue> _queue;
    const Duration _period, _leeway;
    const Work _handler;
    Scheduler::Clock::time_point _due = Scheduler::Clock::now();
    std::atomic<bool> _cancelled = false, _waits = false;
};

class ScheduledTimer : public platform::Timer {
public:
    explicit ScheduledTimer(std::shared_ptr<TimerState> state)
        : _state(std::move(state))
    {
    }
    ~ScheduledTimer() override { _state->cancel(); }
    void cancel() override { _state->cancel(); }

private:
    std::shared_ptr<TimerState> _state;
};

} // namespace

GLibDispatch::GLibDispatch()
    : _mainQueue(std::make_shared<MainQueue>())
    , _serialPool(std::make_shared<WorkerPool>(QualityOfService::UserInitiated, serialThreads))
    , _scheduler(std::make_shared<Scheduler>())
{
    for (std::size_t i = 0; i < _operationPools.size(); ++i) {
        const auto quality = static_cast<QualityOfService>(i);
        _operationPools[i] = std::make_shared<WorkerPool>(quality, threadsFor(quality));
    }
}

GLibDispatch::~GLibDispatch() = default;

void GLibDispatch::stopWorkers()
{
    _serialPool->stop();
    for (const auto& pool : _operationPools)
        pool->stop();
}

std::shared_ptr<Queue> GLibDispatch::makeSerialQueue(std::string label)
{
    return std::make_shared<SerialQueue>(_serialPool, std::move(label));
}

std::shared_ptr<platform::OperationQueue> GLibDispatch::makeOperationQueue(
    std::string name, QualityOfService quality)
{
    const auto& pool = _operationPools[static_cast<std::size_t>(quality)];
    return std::make_shared<PoolOperationQueue>(pool, std::move(name), quality);
}

void GLibDispatch::after(Duration delay, const std::shared_ptr<Queue>& queue, Work work)
{
    const auto due = Scheduler::Clock::now() + std::chrono::duration_cast<Scheduler::Clock::duration>(delay);
    _scheduler->schedule(due, Duration::zero(), [queue, work = std::move(work)] { queue->async(work); });
}

std::unique_ptr<platform::Timer> GLibDispatch::startTimer(
    const std::shared_ptr<Queue>& queue, Duration period, Duration leeway, Work handler)
{
    auto state = std::make_shared<TimerState>(_scheduler, queue, period, leeway, std::move(handler));
    state->start();
    return std::make_unique<ScheduledTimer>(std::move(state));
}

platform::Date GLibDispatch::now() const
{
    return platform::Date::fromTimePoint(std::chrono::system_clock::now());
}

void GLibDispatch::runMainQueueUntil(const std::function<bool()>& isOver)
{
    while (!isOver())
        g_main_context_iteration(nullptr, TRUE);
}

} // namespace host::system
