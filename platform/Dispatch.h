// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace platform {

/// A piece of work for a queue. It runs once, or never when its queue is destroyed before its turn. It must
/// not throw. It should capture weakly what may end first.
using Work = std::function<void()>;

/// A span of time in nanoseconds.
using Duration = std::chrono::nanoseconds;

/// How urgent the work of an operation queue is, the most urgent first. On Linux the last two give way to the
/// interface, and Background work gives way to everything else, at the disk too.
enum class QualityOfService { UserInteractive, UserInitiated, Utility, Background };

/// A serial queue: it takes work and runs it later, one piece at a time and in the order in which it was
/// added, on whichever thread is free. Destroying the queue drops what has not begun and lets the running
/// work end.
class Queue {
public:
    virtual ~Queue() = default;
    /// Adds work and returns at once. Any thread may add, also work that runs on this queue.
    virtual void async(Work work) = 0;
    /// The name that the queue was made with, for logs and debuggers.
    virtual const std::string& label() const = 0;
};

/// A concurrent queue: it takes work and runs it later, several pieces at once and in no promised order.
/// Destroying the queue drops what has not begun and lets the running work end.
class OperationQueue {
public:
    virtual ~OperationQueue() = default;
    /// Adds work and returns at once. Any thread may add, also work that runs on this queue.
    virtual void addOperation(Work work) = 0;
    /// The name and the urgency that the queue was made with.
    virtual const std::string& name() const = 0;
    virtual QualityOfService qualityOfService() const = 0;
};

/// A timer that was started. It stops when it is cancelled or destroyed, from any thread; a handler that is
/// running at that moment runs to its end.
class Timer {
public:
    virtual ~Timer() = default;
    /// Stops the timer. No call of the handler is added to the queue after this; one that waits there already
    /// is dropped when its turn comes.
    virtual void cancel() = 0;
};

/// Makes the program's queues and timers. Every asynchronous hop of the program goes through here, because
/// tests replace this service by one whose clock only the test moves. Any thread may call.
class Dispatch {
public:
    virtual ~Dispatch() = default;

    /// The queue of the user interface; every call answers the same one. Its work runs in the application's
    /// loop, on the main thread, taking turns with the drawing of frames; input comes before both.
    virtual std::shared_ptr<Queue> mainQueue() = 0;
    /// Whether the caller runs on the main thread.
    virtual bool isMainThread() const = 0;

    /// Makes a queue that runs one piece of work at a time. It ends when its last owner lets it go.
    virtual std::shared_ptr<Queue> makeSerialQueue(std::string label) = 0;
    /// Makes a queue that runs several pieces of work at once, as many as the machine has threads for this
    /// urgency. It ends when its last owner lets it go.
    virtual std::shared_ptr<OperationQueue> makeOperationQueue(
        std::string name, QualityOfService quality) = 0;

    /// Adds work to a queue once, after a delay, and keeps the queue until then. The work cannot be taken
    /// back, so it must capture weakly whatever may end before it runs. The delay is measured on a clock that
    /// nobody sets.
    virtual void after(Duration delay, const std::shared_ptr<Queue>& queue, Work work) = 0;

    /// Starts a timer that calls a handler on a queue, first at once and then every `period` (a millisecond
    /// at least). Each call may come up to `leeway` late, so that timers can share one waking of the
    /// processor. While a call still waits in the queue no second one is added, and calls that were missed
    /// while the machine slept are left out. The timer stops when the answer is destroyed.
    virtual std::unique_ptr<Timer> startTimer(
        const std::shared_ptr<Queue>& queue, Duration period, Duration leeway, Work handler) = 0;

    /// The time now, on the wall clock, which people and other programs may set.
    virtual Date now() const = 0;
};

} // namespace platform
