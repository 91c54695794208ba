// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/WorkerPool.h"

#include <sched.h>
#include <sys/resource.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <condition_variable>
#include <deque>
#include <mutex>
#include <thread>
#include <vector>

namespace host::system {

using platform::QualityOfService;
using platform::Work;

struct WorkerPool::State {
    QualityOfService quality;
    std::size_t maximumThreads;
    std::mutex mutex;
    std::condition_variable wake;
    std::deque<Work> pending;
    std::vector<std::thread> threads;
    std::size_t idle = 0;
    bool stopped = false;
};

namespace {

void lowerPriority(QualityOfService quality)
{
    if (quality == QualityOfService::Utility) {
        // A batch thread never takes the processor from the interface. Its niceness stays, because nobody but
        // root may take a higher one back: GLib gives the threads of its shared pool the scheduling of the
        // thread that made the pool, also when a worker needs another of these threads, and warns if it may
        // not.
        const sched_param noRealTime{};
        sched_setscheduler(0, SCHED_BATCH, &noRealTime);
    } else if (quality == QualityOfService::Background) {
        // On Linux the niceness of "process" 0 is that of the calling thread alone.
        constexpr int veryNice = 15, whoIsThread = 1, lowestBestEffort = (2 << 13) | 7;
        setpriority(PRIO_PROCESS, 0, veryNice);
        syscall(SYS_ioprio_set, whoIsThread, 0, lowestBestEffort);
    }
}

void runWorker(const auto& state)
{
    lowerPriority(state->quality);
    std::unique_lock lock(state->mutex);
    for (;;) {
        ++state->idle;
        state->wake.wait(lock, [&] { return state->stopped || !state->pending.empty(); });
        --state->idle;
        if (state->stopped)
            return;
        auto work = std::move(state->pending.front());
        state->pending.pop_front();
        lock.unlock();
        work();
        work = nullptr; // the captured objects are destroyed here, outside the lock
        lock.lock();
    }
}

} // namespace

WorkerPool::WorkerPool(QualityOfService quality, std::size_t maximumThreads)
    : _state(std::make_shared<State>())
{
    _state->quality = quality;
    _state->maximumThreads = maximumThreads;
}

WorkerPool::~WorkerPool()
{
    stop();
}

void WorkerPool::stop()
{
    std::deque<Work> dropped;
    std::vector<std::thread> threads;
    {
        const std::lock_guard lock(_state->mutex);
        _state->stopped = true;
        dropped.swap(_state->pending);
        threads.swap(_state->threads);
    }
    _state->wake.notify_all();
    for (auto& thread : threads) {
        if (thread.get_id() == std::this_thread::get_id())
            thread.detach();
        else
            thread.join();
    }
}

void WorkerPool::submit(Work work)
{
    {
        const std::lock_guard lock(_state->mutex);
        if (_state->stopped)
            return;
        _state->pending.push_back(std::move(work));
        if (_state->idle < _state->pending.size() && _state->threads.size() < _state->maximumThreads)
            _state->threads.emplace_back([state = _state] { runWorker(state); });
    }
    _state->wake.notify_one();
}

} // namespace host::system
