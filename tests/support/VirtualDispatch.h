// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"

#include <cstdint>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace testing_support {

/// Queues and timers on a clock that only the test moves. Work of every queue runs on the thread that drives
/// it, in the order of due times and, within one moment, of submission. Any thread may add work.
class VirtualDispatch : public platform::Dispatch, public std::enable_shared_from_this<VirtualDispatch> {
public:
    static std::shared_ptr<VirtualDispatch> create() { return std::make_shared<VirtualDispatch>(); }

    std::shared_ptr<platform::Queue> mainQueue() override;
    bool isMainThread() const override { return std::this_thread::get_id() == _owner; }
    std::shared_ptr<platform::Queue> makeSerialQueue(std::string label) override;
    std::shared_ptr<platform::OperationQueue> makeOperationQueue(
        std::string name, platform::QualityOfService quality) override;
    void after(platform::Duration delay, const std::shared_ptr<platform::Queue>& queue,
        platform::Work work) override;
    std::unique_ptr<platform::Timer> startTimer(const std::shared_ptr<platform::Queue>& queue,
        platform::Duration period, platform::Duration leeway, platform::Work handler) override;
    platform::Date now() const override;

    /// Runs the work that is due now, and the work that it adds for now, until nothing is left.
    void runUntilIdle();
    /// Moves the clock by seconds, and runs work that falls due on the way at its own time.
    void advance(double seconds);
    /// Drops all waiting work and all that is added from now on, because work may hold the queues that hold
    /// it.
    void end();
    /// Answers how many pieces of work wait, timers included.
    std::size_t pendingCount() const;

    /// Adds work that is dropped when the queue for which it waits is destroyed first.
    void submit(platform::Duration delay, std::weak_ptr<const void> queue, platform::Work work);

private:
    struct Pending {
        std::int64_t due;
        std::uint64_t order;
        std::weak_ptr<const void> queue;
        platform::Work work;
    };
    bool runNext(std::int64_t limit);

    mutable std::mutex _mutex;
    std::vector<Pending> _pending;
    std::int64_t _now =
        1'700'000'000'000'000'000; // a fixed moment of 2023, so that texts with dates do not change
    std::uint64_t _nextOrder = 0;
    bool _hasEnded = false;
    std::thread::id _owner = std::this_thread::get_id();
    std::shared_ptr<platform::Queue> _mainQueue;
};

} // namespace testing_support
