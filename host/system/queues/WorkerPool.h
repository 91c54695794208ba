// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <cstddef>
#include <memory>

namespace host::system {

/// A bounded number of threads that run work in the order in which it was submitted. Threads start when there
/// is work for them and stay. Any thread may submit.
class WorkerPool {
public:
    /// `quality` chooses how the kernel schedules the threads: Utility gives way to the interface, Background
    /// to everything, on the disk too.
    WorkerPool(platform::QualityOfService quality, std::size_t maximumThreads);
    /// Drops what has not begun and waits for what has; the thread that calls is not waited for when it is
    /// one of the pool's own.
    ~WorkerPool();
    WorkerPool(const WorkerPool&) = delete;
    WorkerPool& operator=(const WorkerPool&) = delete;

    void submit(platform::Work work);

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
