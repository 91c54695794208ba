// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/queues/GLibDispatch.h"
#include "tests/support/VirtualDispatch.h"

#include <glib.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <future>
#include <latch>
#include <thread>

using namespace platform;
using namespace std::chrono_literals;
using testing_support::VirtualDispatch;

namespace {

/// A dispatch, and a function that runs its work.
struct Driver {
    std::shared_ptr<Dispatch> dispatch;
    std::function<void(const std::function<bool()>&)> runUntil;
};

void iterateUntil(const std::function<bool()>& done)
{
    const auto deadline = std::chrono::steady_clock::now() + 30s;
    while (!done() && std::chrono::steady_clock::now() < deadline) {
        // Work on another thread does not wake this loop, so a loop that only waits must not block.
        if (!g_main_context_iteration(nullptr, FALSE))
            std::this_thread::yield();
    }
}

Driver realDriver()
{
    return {std::make_shared<host::system::GLibDispatch>(), iterateUntil};
}

Driver virtualDriver()
{
    auto dispatch = VirtualDispatch::create();
    return {dispatch, [dispatch](const std::function<bool()>& done) {
                for (int i = 0; i < 10'000 && !done(); ++i)
                    dispatch->advance(0.001);
            }};
}

/// Checks the promises of platform/Dispatch.h for the host's queues and for the tests' own ones.
class DispatchContract : public testing::TestWithParam<Driver (*)()> {
protected:
    void runUntil(const std::function<bool()>& done)
    {
        driver.runUntil(done);
        ASSERT_TRUE(done());
    }
    Driver driver = GetParam()();
    Dispatch& dispatch = *driver.dispatch;
};

INSTANTIATE_TEST_SUITE_P(Dispatches, DispatchContract, testing::Values(&realDriver, &virtualDriver),
    [](const auto& row) { return row.index == 0 ? "GLib" : "Virtual"; });

TEST_P(DispatchContract, MainQueueRunsLaterInOrderOnTheMainThread)
{
    std::vector<int> order;
    dispatch.mainQueue()->async([&] {
        EXPECT_TRUE(dispatch.isMainThread());
        order.push_back(1);
        dispatch.mainQueue()->async([&] { order.push_back(3); });
    });
    std::thread([&] { dispatch.mainQueue()->async([&] { order.push_back(2); }); }).join();
    EXPECT_TRUE(order.empty());
    runUntil([&] { return order.size() == 3; });
    EXPECT_EQ(order, (std::vector{1, 2, 3}));
}

TEST_P(DispatchContract, SerialQueueRunsOneAtATimeInOrder)
{
    const auto queue = dispatch.makeSerialQueue("numbers");
    EXPECT_EQ(queue->label(), "numbers");
    std::vector<int> order;
    std::atomic<int> running = 0, finished = 0;
    for (int i = 0; i < 500; ++i)
        queue->async([&, i] {
            EXPECT_EQ(++running, 1);
            order.push_back(i);
            --running;
            ++finished;
        });
    runUntil([&] { return finished == 500; });
    EXPECT_TRUE(std::ranges::is_sorted(order));
}

TEST_P(DispatchContract, DelayedWorkComesInTheOrderOfItsTimes)
{
    std::vector<int> order;
    dispatch.after(30ms, dispatch.mainQueue(), [&] { order.push_back(2); });
    dispatch.after(1ms, dispatch.mainQueue(), [&] { order.push_back(1); });
    runUntil([&] { return order.size() == 2; });
    EXPECT_EQ(order, (std::vector{1, 2}));
}

TEST_P(DispatchContract, TimerCallsAtOnceThenAgainUntilItEnds)
{
    int calls = 0;
    auto timer = dispatch.startTimer(dispatch.mainQueue(), 1ms, 0ms, [&] { ++calls; });
    runUntil([&] { return calls >= 3; });
    const auto counted = calls;
    timer->cancel();
    bool later = false;
    dispatch.after(20ms, dispatch.mainQueue(), [&] { later = true; });
    runUntil([&] { return later; });
    EXPECT_EQ(calls, counted);
}

TEST_P(DispatchContract, WorkOfADestroyedQueueNeverRunsAndLetsGoOfWhatItHolds)
{
    auto held = std::make_shared<int>();
    std::weak_ptr<int> watched = held;
    bool ran = false, later = false;
    // The first piece of work destroys the queue on which it runs, so nothing may wait for itself.
    auto queue = dispatch.makeSerialQueue("short-lived");
    std::promise<void> bothAreIn;
    std::atomic<bool> isGone = false;
    queue->async([&] {
        bothAreIn.get_future().wait();
        queue.reset();
        isGone = true;
    });
    queue->async([&ran, kept = std::move(held)] { ran = true; });
    bothAreIn.set_value();
    runUntil([&] { return isGone && watched.expired(); });
    dispatch.after(5ms, dispatch.mainQueue(), [&] { later = true; });
    runUntil([&] { return later; });
    EXPECT_FALSE(ran);
}

TEST(GLibDispatch, OperationsRunAtTheSameTime)
{
    host::system::GLibDispatch dispatch;
    const auto queue = dispatch.makeOperationQueue("pair", QualityOfService::UserInitiated);
    std::latch both(2), done(2);
    for (int i = 0; i < 2; ++i)
        queue->addOperation([&] {
            both.arrive_and_wait(); // never returns when the second operation waits for the first to end
            done.count_down();
        });
    done.wait();
}

TEST(GLibDispatch, TimerWhoseCallStillWaitsDoesNotCallTwice)
{
    host::system::GLibDispatch dispatch;
    const auto queue = dispatch.makeSerialQueue("slow");
    std::promise<void> release;
    queue->async([&] { release.get_future().wait(); });
    std::atomic<int> calls = 0;
    const auto timer = dispatch.startTimer(queue, 1ms, 0ms, [&] { ++calls; });
    bool later = false;
    dispatch.after(20ms, dispatch.mainQueue(), [&] { later = true; });
    iterateUntil([&] { return later; });
    std::atomic<int> seen = -1;
    queue->async([&] { seen = calls.load(); });
    release.set_value();
    iterateUntil([&] { return seen >= 0; });
    EXPECT_EQ(seen, 1);
    std::promise<void> drained;
    timer->cancel();
    queue->async([&] { drained.set_value(); });
    drained.get_future().wait();
}

TEST(GLibDispatch, EndsWhileWorkWaitsEverywhere)
{
    const auto held = std::make_shared<int>();
    std::atomic<bool> began = false;
    auto dispatch = std::make_unique<host::system::GLibDispatch>();
    const auto serial = dispatch->makeSerialQueue("serial");
    const auto timer = dispatch->startTimer(serial, 1h, 1s, [held] {});
    serial->async([&began] {
        began = true;
        std::this_thread::yield();
    });
    dispatch->mainQueue()->async([held] {});
    dispatch->after(1h, dispatch->mainQueue(), [held] {});
    iterateUntil([&] { return began.load(); });
    dispatch.reset();
    serial->async([held] {}); // a queue without its dispatch takes work and never runs it
    EXPECT_LE(held.use_count(), 4);
}

TEST(GLibDispatchTests, EndsTheWorkOfOtherThreads)
{
    host::system::GLibDispatch dispatch;
    const auto queue = dispatch.makeSerialQueue("work");
    std::promise<void> begun;
    std::atomic<int> ended = 0;
    queue->async([&] {
        begun.set_value();
        std::this_thread::sleep_for(20ms);
        ++ended;
    });
    queue->async([&] { ended += 10; });
    begun.get_future().wait();
    dispatch.stopWorkers();
    EXPECT_EQ(ended, 1) << "what had begun was waited for, and nothing else began";
    queue->async([&] { ended += 100; });
    dispatch.makeOperationQueue("more", QualityOfService::Utility)->addOperation([&] { ended += 100; });
    std::this_thread::sleep_for(5ms);
    EXPECT_EQ(ended, 1);
}

} // namespace
