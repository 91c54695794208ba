// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <cstddef>
#include <memory>

namespace host::system {

/// A bounded number of threads that run work in the order of its submission. Threads start when there is work
/// for them and stay. Any thread may submit.
class WorkerPool {
public:
    /// `quality` decides how the kernel schedules the threads: Utility yields to the interface, Background to
    /// everything, also on the disk.
    WorkerPool(platform::QualityOfService quality, std::size_t maximumThreads);
    /// Drops work that has not begun and waits for work that has. When the calling thread is one of the
    /// pool's own, it is not waited for.
    ~WorkerPool();
    WorkerPool(const WorkerPool&) = delete;
    WorkerPool& operator=(const WorkerPool&) = delete;

    void submit(platform::Work work);
    /// Ends the pool as its destructor does; what is submitted later is dropped.
    void stop();

private:
    struct State;
    std::shared_ptr<State> _state;
};

} // namespace host::system
