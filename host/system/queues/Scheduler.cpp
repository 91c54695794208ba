// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/Scheduler.h"

#include <algorithm>
#include <condition_variable>
#include <map>
#include <mutex>
#include <vector>

namespace host::system {

using platform::Duration;
using platform::Work;

struct Scheduler::State {
    struct Entry {
        Clock::time_point latest;
        Work handler;
    };
    std::mutex mutex;
    std::condition_variable wake;
    std::multimap<Clock::time_point, Entry> entries; // by due time; equal ones stay in order
    bool stopped = false;

    Clock::time_point nextWaking() const
    {
        auto next = Clock::time_point::max();
        for (const auto& [due, entry] : entries) {
            if (due > next)
                break;
            next = std::min(next, entry.latest);
        }
        return next;
    }

    std::vector<Work> takeDue()
    {
        const auto end = entries.upper_bound(Clock::now());
        std::vector<Work> due;
        for (auto entry = entries.begin(); entry != end; ++entry)
            due.push_back(std::move(entry->second.handler));
        entries.erase(entries.begin(), end);
        return due;
    }
};

Scheduler::Scheduler()
    : _state(std::make_shared<State>())
    , _thread([state = _state] { run(state); })
{
}

Scheduler::~Scheduler()
{
    std::multimap<Clock::time_point, State::Entry> dropped;
    {
        const std::lock_guard lock(_state->mutex);
        _state->stopped = true;
        dropped.swap(_state->entries);
    }
    _state->wake.notify_all();
    if (_thread.get_id() == std::this_thread::get_id())
        _thread.detach();
    else
        _thread.join();
}

void Scheduler::schedule(Clock::time_point due, Duration leeway, Work handler)
{
    const auto latest = due + std::chrono::duration_cast<Clock::duration>(std::max(leeway, Duration::zero()));
    {
        const std::lock_guard lock(_state->mutex);
        _state->entries.emplace(due, State::Entry{latest, std::move(handler)});
    }
    _state->wake.notify_one();
}

void Scheduler::run(const std::shared_ptr<State>& state)
{
    std::unique_lock lock(state->mutex);
    while (!state->stopped) {
        const auto next = state->nextWaking();
        if (next == Clock::time_point::max())
            state->wake.wait(lock);
        else if (Clock::now() < next)
            state->wake.wait_until(lock, next);
        else {
            auto due = state->takeDue();
            lock.unlock();
            for (const auto& handler : due)
                handler();
            due.clear(); // the captured objects are destroyed here, outside the lock
            lock.lock();
        }
    }
}

} // namespace host::system
