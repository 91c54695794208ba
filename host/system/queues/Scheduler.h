// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <chrono>
#include <memory>
#include <thread>

namespace host::system {

/// One thread that calls brief handlers at their times. The clock is monotonic. Any thread may schedule.
class Scheduler {
public:
    using Clock = std::chrono::steady_clock;

    Scheduler();
    /// Drops handlers that are not due yet and waits for one that runs, unless it runs on this thread.
    ~Scheduler();
    Scheduler(const Scheduler&) = delete;
    Scheduler& operator=(const Scheduler&) = delete;

    /// Calls the handler once, at `due` or up to `leeway` later, so that handlers whose spans overlap share
    /// one wake-up.
    void schedule(Clock::time_point due, platform::Duration leeway, platform::Work handler);

private:
    struct State;
    static void run(const std::shared_ptr<State>& state);
    std::shared_ptr<State> _state;
    std::thread _thread;
};

} // namespace host::system
