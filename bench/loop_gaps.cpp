// A library to preload: reports how long the main thread stays away from its loop.
//
// LD_PRELOAD=libloop_gaps.so PROGRAM prints a line on standard error for each turn of the main loop that took
// longer than 8 ms of wall time, with the time since the start, and at the end the longest turn. The loop
// sleeps in poll(); a turn is what lies between one return from it and the next call.

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <dlfcn.h>
#include <poll.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace {

using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;

constexpr double longTurn = 8; // milliseconds: half a frame

const Clock::time_point start = Clock::now();
Clock::time_point turnBegan = start;
double longest = 0;

bool isMainThread()
{
    return getpid() == syscall(SYS_gettid);
}

void endTurn()
{
    const double length = Milliseconds(Clock::now() - turnBegan).count();
    if (length > longTurn)
        std::fprintf(stderr, "turn of %.1f ms at %.0f ms\n", length, Milliseconds(turnBegan - start).count());
    longest = length > longest ? length : longest;
}

struct Report {
    ~Report() { std::fprintf(stderr, "longest turn %.1f ms\n", longest); }
} report;

} // namespace

extern "C" int poll(pollfd* descriptors, nfds_t count, int timeout)
{
    using Poll = int (*)(pollfd*, nfds_t, int);
    static const auto next = reinterpret_cast<Poll>(dlsym(RTLD_NEXT, "poll"));
    if (!isMainThread())
        return next(descriptors, count, timeout);
    endTurn();
    const int result = next(descriptors, count, timeout);
    turnBegan = Clock::now();
    return result;
}
