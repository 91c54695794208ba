// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/queues/MainQueue.h"
#include "platform/Dispatch.h"

#include <array>
#include <functional>
#include <memory>

namespace host::system {

class Scheduler;
class WorkerPool;

/// Queues on GLib's default main context and on bounded pools of threads: one pool for each quality of
/// service and one for the serial queues. Make and destroy it on the main thread, and destroy it after
/// everything that uses it. Work that has not begun by then never runs, and work that has is waited for.
class GLibDispatch : public platform::Dispatch {
public:
    GLibDispatch();
    ~GLibDispatch() override;

    std::shared_ptr<platform::Queue> mainQueue() override { return _mainQueue; }
    bool isMainThread() const override { return _mainQueue->isCurrentThread(); }
    std::shared_ptr<platform::Queue> makeSerialQueue(std::string label) override;
    std::shared_ptr<platform::OperationQueue> makeOperationQueue(
        std::string name, platform::QualityOfService quality) override;
    void after(platform::Duration delay, const std::shared_ptr<platform::Queue>& queue,
        platform::Work work) override;
    std::unique_ptr<platform::Timer> startTimer(const std::shared_ptr<platform::Queue>& queue,
        platform::Duration period, platform::Duration leeway, platform::Work handler) override;
    platform::Date now() const override;
    /// Serves programs without a window: runs the main queue until `isOver`, which is asked after each piece
    /// of work, answers true. Called on the main thread.
    void runMainQueueUntil(const std::function<bool()>& isOver);
    /// Ends the work on other threads: drops what has not begun, waits for the rest, and drops what is added
    /// later. The program calls this before it takes away what the work uses.
    void stopWorkers();

private:
    std::shared_ptr<MainQueue> _mainQueue;
    std::shared_ptr<WorkerPool> _serialPool;
    std::array<std::shared_ptr<WorkerPool>, 4> _operationPools; // indexed by QualityOfService
    std::shared_ptr<Scheduler> _scheduler;
};

} // namespace host::system
