// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This library, when preloaded, reports how long the main thread stays away from its loop.
//
// LD_PRELOAD=libloop_gaps.so PROGRAM prints a line on standard error for each turn of the main loop that took
// longer than 8 ms of wall time, with the processor time of the thread in it and the time since the start. At
// the end it prints the longest turn. The loop sleeps in poll(); a turn is the time between one return from
// it and the next call. On a busy machine the processor time is the more telling one.

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <dlfcn.h>
#include <poll.h>
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

namespace {

using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;

constexpr double longTurn = 8; // milliseconds, half a frame

/// Answers the processor time of this thread so far, in milliseconds.
double computed()
{
    timespec used{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &used);
    return static_cast<double>(used.tv_sec) * 1e3 + static_cast<double>(used.tv_nsec) / 1e6;
}

const Clock::time_point start = Clock::now();
Clock::time_point turnBegan = start;
double computedBefore = 0, longest = 0, longestComputed = 0;

bool isMainThread()
{
    return getpid() == syscall(SYS_gettid);
}

void endTurn()
{
    const double length = Milliseconds(Clock::now() - turnBegan).count();
    const double own = computed() - computedBefore;
    if (length > longTurn)
        std::fprintf(stderr, "turn of %.1f ms (%.1f computing) at %.0f ms\n", length, own,
            Milliseconds(turnBegan - start).count());
    longest = length > longest ? length : longest;
    longestComputed = own > longestComputed ? own : longestComputed;
}

struct Report {
    ~Report()
    {
        std::fprintf(stderr, "longest turn %.1f ms, longest computing %.1f ms\n", longest, longestComputed);
    }
} report;

} // namespace

// NOLINTNEXTLINE(readability-inconsistent-declaration-parameter-name): names of the library
extern "C" int poll(pollfd* descriptors, nfds_t count, int timeout)
{
    using Poll = int (*)(pollfd*, nfds_t, int);
    static const auto next = reinterpret_cast<Poll>(dlsym(RTLD_NEXT, "poll"));
    if (!isMainThread())
        return next(descriptors, count, timeout);
    endTurn();
    const int result = next(descriptors, count, timeout);
    turnBegan = Clock::now();
    computedBefore = computed();
    return result;
}
