// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures how soon an open list shows a change on disk, beside a bare loop over inotify and statx in
// the same run, and how long the main loop is blocked while 10,000 files arrive.
//
// "latency_ms" begins when the file is being made and ends on the main thread when the list's rows contain
// the new name. It includes 10 ms for which the list waits for the next step of a saving program. A list of
// 100,000 items is measured in other orders, too; its items are read once, not at every change.

#include "ListedFolders.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/queues/GLibDispatch.h"
#include "platform/Services.h"
#include "screens/list/FolderContents.h"

#include <benchmark/benchmark.h>
#include <glib.h>
#include <malloc.h>
#include <poll.h>
#include <sys/inotify.h>
#include <time.h>

#include <array>
#include <atomic>
#include <thread>

namespace {

using namespace bench;
using screens::FolderContents;
using screens::ListOrder;
using screens::OrderKey;

constexpr int changesTimed = 40;
constexpr int arrivals = 10'000;

std::shared_ptr<host::system::GLibDispatch> installedDispatch()
{
    static const auto dispatch = [] {
        auto made = std::make_shared<host::system::GLibDispatch>();
        const auto types = std::make_shared<host::system::MimeTypeRegistry>();
        platform::ServiceSet set;
        set.dispatch = made;
        set.typeRegistry = types;
        set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
        set.folderLister = std::make_shared<host::system::ThreadedFolderLister>(made, types, "en_US");
        platform::installServices(set);
        return made;
    }();
    return dispatch;
}

/// Measures the longest turns of GLib's main loop while it lives. A turn is the time between two calls of
/// poll().
class TurnMeter {
public:
    TurnMeter()
    {
        _wall = _computing = 0;
        begin();
        g_main_context_set_poll_func(nullptr, poll);
    }
    ~TurnMeter() { g_main_context_set_poll_func(nullptr, g_poll); }
    static double longest() { return _wall; }
    static double longestComputing() { return _computing; }

private:
    static double computed()
    {
        timespec used{};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &used);
        return static_cast<double>(used.tv_sec) * 1e3 + static_cast<double>(used.tv_nsec) / 1e6;
    }
    static void begin()
    {
        _began = Clock::now();
        _computedBefore = computed();
    }
    static gint poll(GPollFD* descriptors, guint count, gint timeout)
    {
        _wall = std::max(_wall, milliseconds(Clock::now() - _began));
        _computing = std::max(_computing, computed() - _computedBefore);
        const gint found = g_poll(descriptors, count, timeout);
        begin();
        return found;
    }
    static inline Clock::time_point _began;
    static inline double _computedBefore = 0, _wall = 0, _computing = 0;
};

/// An open list of a folder.
class OpenList {
public:
    OpenList(const std::string& path, const ListOrder& order)
    {
        _dispatch = installedDispatch();
        _contents = FolderContents::create(
            platform::Url::fileURL(path), [this](const screens::FolderContentsUpdate& update) {
                ++_updates;
                _isComplete = update.stage == platform::ListingStage::Complete;
            });
        _contents->start({}, order);
        runUntil([this] { return _isComplete; });
    }
    template <typename Condition>
    static void runUntil(const Condition& condition)
    {
        while (!condition())
            g_main_context_iteration(nullptr, TRUE);
    }
    std::size_t count() const { return _contents->rows()->count(); }
    int updates() const { return _updates; }
    /// Lets the list's pending work come to its end.
    static void rest(std::chrono::milliseconds pause)
    {
        bool isOver = false;
        installedDispatch()->after(pause, installedDispatch()->mainQueue(), [&] { isOver = true; });
        runUntil([&] { return isOver; });
    }

private:
    std::shared_ptr<host::system::GLibDispatch> _dispatch;
    std::shared_ptr<FolderContents> _contents;
    int _updates = 0;
    bool _isComplete = false;
};

void makeFile(const std::string& path)
{
    ::close(::open(path.c_str(), O_CREAT | O_WRONLY | O_CLOEXEC, 0600));
}

/// Answers the time from making a file to reading its attributes, with nothing but the kernel between.
double floorOnce(int queue, const std::string& path)
{
    const auto began = Clock::now();
    makeFile(path);
    alignas(inotify_event) char buffer[4096];
    benchmark::DoNotOptimize(::read(queue, buffer, sizeof buffer));
    struct statx found;
    statx(AT_FDCWD, path.c_str(), AT_SYMLINK_NOFOLLOW, STATX_BASIC_STATS, &found);
    const auto took = milliseconds(Clock::now() - began);
    ::unlink(path.c_str());
    while (poll(std::array{pollfd{queue, POLLIN, 0}}.data(), 1, 5) > 0)
        benchmark::DoNotOptimize(::read(queue, buffer, sizeof buffer));
    return took;
}

std::vector<double> floors(const std::string& path)
{
    const int queue = inotify_init1(IN_CLOEXEC);
    inotify_add_watch(queue, path.c_str(), IN_CREATE | IN_DELETE);
    std::vector<double> took;
    took.reserve(changesTimed);
    for (int i = 0; i < changesTimed; ++i)
        took.push_back(floorOnce(queue, path + "/Photo of the sea.jpg"));
    ::close(queue);
    return took;
}

void showChange(benchmark::State& state, const ListOrder& order)
{
    const auto& path = folders().ofSize(static_cast<int>(state.range(0)));
    const auto floor = floors(path);
    OpenList list(path, order);
    const auto name = path + "/Photo of the sea.jpg";
    std::vector<double> latencies, turns;
    for (auto _ : state) {
        for (int i = 0; i < changesTimed; ++i) {
            OpenList::rest(std::chrono::milliseconds(150));
            const auto before = list.count();
            const TurnMeter meter;
            const auto began = Clock::now();
            makeFile(name);
            OpenList::runUntil([&] { return list.count() == before + 1; });
            latencies.push_back(milliseconds(Clock::now() - began));
            ::unlink(name.c_str());
            OpenList::runUntil([&] { return list.count() == before; });
            turns.push_back(TurnMeter::longestComputing());
        }
    }
    state.counters["latency_ms"] = median(latencies);
    state.counters["p95_ms"] = percentile(latencies, 0.95);
    state.counters["floor_ms"] = median(floor);
    state.counters["x_floor"] = median(latencies) / median(floor);
    state.counters["turn_ms"] = percentile(turns, 1);
}

void showChangeByName(benchmark::State& state)
{
    showChange(state, {});
}
BENCHMARK(showChangeByName)
    ->Arg(100)
    ->Arg(10'000)
    ->Arg(100'000)
    ->Iterations(1)
    ->Unit(benchmark::kMillisecond);

void showChangeByDate(benchmark::State& state)
{
    showChange(state, {OrderKey::Date, screens::OrderDirection::Descending});
}
BENCHMARK(showChangeByDate)->Arg(100'000)->Iterations(1)->Unit(benchmark::kMillisecond);

/// Makes files as quickly as a thread can while the list is open.
void filesArrive(benchmark::State& state)
{
    const auto& path = folders().ofSize(static_cast<int>(state.range(0)));
    OpenList list(path, {});
    const auto before = list.count();
    const auto name = [&](int i) { return path + "/Photo " + std::to_string(i * 7919 % arrivals) + ".jpg"; };
    for (auto _ : state) {
        OpenList::rest(std::chrono::milliseconds(200));
        const auto updatesBefore = list.updates();
        const TurnMeter meter;
        std::atomic<double> madeIn = 0;
        const auto began = Clock::now();
        const std::jthread maker([&] {
            for (int i = 0; i < arrivals; ++i)
                makeFile(name(i));
            madeIn = milliseconds(Clock::now() - began);
        });
        OpenList::runUntil([&] { return list.count() == before + arrivals; });
        state.counters["made_ms"] = madeIn.load();
        state.counters["behind_ms"] = milliseconds(Clock::now() - began) - madeIn;
        state.counters["updates"] = list.updates() - updatesBefore;
        state.counters["turn_ms"] = TurnMeter::longest();
        state.counters["turn_computing_ms"] = TurnMeter::longestComputing();
    }
    for (int i = 0; i < arrivals; ++i)
        ::unlink(name(i).c_str());
    OpenList::runUntil([&] { return list.count() == before; });
}
BENCHMARK(filesArrive)->Arg(100)->Arg(100'000)->Iterations(1)->Unit(benchmark::kMillisecond);

/// Measures the memory of an open list for each of its items, and its growth after 10,000 files came and
/// went.
void memoryOfAnItem(benchmark::State& state)
{
    const auto& path = folders().ofSize(100'000);
    const auto used = [] {
        const auto info = mallinfo2();
        return static_cast<double>(info.uordblks + info.hblkhd);
    };
    for (auto _ : state) {
        OpenList::rest(std::chrono::milliseconds(100));
        const auto before = used();
        OpenList list(path, {});
        OpenList::rest(std::chrono::milliseconds(100));
        state.counters["bytes_an_item"] = (used() - before) / 100'000;
        for (int i = 0; i < arrivals; ++i)
            makeFile(path + "/Photo " + std::to_string(i));
        OpenList::runUntil([&] { return list.count() == 110'000; });
        for (int i = 0; i < arrivals; ++i)
            ::unlink((path + "/Photo " + std::to_string(i)).c_str());
        OpenList::runUntil([&] { return list.count() == 100'000; });
        OpenList::rest(std::chrono::milliseconds(100));
        state.counters["after_changes"] = (used() - before) / 100'000;
    }
}
BENCHMARK(memoryOfAnItem)->Iterations(1)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
