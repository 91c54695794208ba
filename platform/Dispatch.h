// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace platform {

/// A piece of work for a queue. It runs once, or never when its queue is destroyed first.
using Work = std::function<void()>;

using Duration = std::chrono::nanoseconds;

/// How urgent the work of an operation queue is, most urgent first.
enum class QualityOfService { UserInteractive, UserInitiated, Utility, Background };

/// Takes work and runs it later, one piece at a time and in order. Any thread may add work.
class Queue {
public:
    virtual ~Queue() = default;
    virtual void async(Work work) = 0;
    virtual const std::string& label() const = 0;
};

/// Takes work and runs it later, several pieces at once. Any thread may add work.
class OperationQueue {
public:
    virtual ~OperationQueue() = default;
    virtual void addOperation(Work work) = 0;
    virtual const std::string& name() const = 0;
    virtual QualityOfService qualityOfService() const = 0;
};

/// A timer that was started. It stops when it is cancelled or destroyed; a handler that is running then ends.
class Timer {
public:
    virtual ~Timer() = default;
    /// After this no handler begins, but for one that already waits in the queue.
    virtual void cancel() = 0;
};

/// Every asynchronous hop of the program goes through here, so that tests can drive time.
class Dispatch {
public:
    virtual ~Dispatch() = default;

    /// The queue of the user interface. Work on it runs in the application's loop, on the main thread.
    virtual std::shared_ptr<Queue> mainQueue() = 0;
    virtual bool isMainThread() const = 0;

    virtual std::shared_ptr<Queue> makeSerialQueue(std::string label) = 0;
    virtual std::shared_ptr<OperationQueue> makeOperationQueue(
        std::string name, QualityOfService quality) = 0;

    /// Runs work on a queue once, after a delay. It cannot be taken back: capture weakly.
    virtual void after(Duration delay, const std::shared_ptr<Queue>& queue, Work work) = 0;

    /// Calls a handler on a queue at once and then every `period`; each call may come up to `leeway` late. A
    /// timer whose last call still waits does not call twice.
    virtual std::unique_ptr<Timer> startTimer(
        const std::shared_ptr<Queue>& queue, Duration period, Duration leeway, Work handler) = 0;

    /// The time now, on the wall clock.
    virtual Date now() const = 0;
};

} // namespace platform
