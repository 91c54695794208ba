// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures a folder's list, from the call until the sorted rows are on the main queue, beside its floor:
// getdents64 and statx of everything in the same folder on one thread. Each size prints the ratio as
// "x_floor" and, for large folders, the time of the first rows.
//
// The folder is made under TMPDIR (/tmp). Run this on an idle machine, because the list uses all cores and
// the floor only one.

#include "ListedFolders.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/listing/EntryClassifier.h"
#include "host/system/listing/NameOrder.h"
#include "host/system/listing/ThreadedFolderLister.h"
#include "host/system/queues/GLibDispatch.h"

#include <benchmark/benchmark.h>
#include <glib.h>

#include <fcntl.h>
#include <sys/stat.h>

#include <chrono>
#include <vector>

namespace {

using bench::Clock;
using bench::folders;
using bench::median;
using bench::milliseconds;
using host::system::DirectoryReader;
using platform::FolderSnapshot;
using platform::ListingStage;

double floorOnce(const std::string& path)
{
    const auto begin = Clock::now();
    const auto folder = host::system::openFolder(path);
    DirectoryReader reader(*folder);
    struct statx found;
    while (const auto entry = reader.next()) {
        // The reader's names end with a null character.
        // NOLINTNEXTLINE(bugprone-suspicious-stringview-data-usage)
        statx(folder->get(), entry->name.data(), AT_SYMLINK_NOFOLLOW, STATX_BASIC_STATS, &found);
        benchmark::DoNotOptimize(found.stx_size);
    }
    return milliseconds(Clock::now() - begin);
}

struct ListTimes {
    double firstRows = 0, complete = 0;
    std::size_t count = 0;
};

ListTimes listOnce(host::system::ThreadedFolderLister& lister, const std::string& path)
{
    ListTimes times;
    const auto begin = Clock::now();
    const auto listing = lister.list(platform::Url::fileURL(path), {}, platform::FolderGrouping::FoldersFirst,
        [&](std::shared_ptr<const FolderSnapshot> snapshot) {
            const auto now = milliseconds(Clock::now() - begin);
            if (times.firstRows == 0)
                times.firstRows = now;
            if (snapshot->stage() == ListingStage::Complete) {
                times.complete = now;
                times.count = snapshot->count();
            }
        });
    while (times.complete == 0)
        g_main_context_iteration(nullptr, TRUE);
    return times;
}

void listFolder(benchmark::State& state)
{
    const auto& path = folders().ofSize(static_cast<int>(state.range(0)));
    const auto dispatch = std::make_shared<host::system::GLibDispatch>();
    host::system::ThreadedFolderLister lister(
        dispatch, std::make_shared<host::system::MimeTypeRegistry>(), "en_US");
    listOnce(lister, path);
    floorOnce(path);
    std::vector<double> complete, firstRows, floors;
    for (auto _ : state) {
        const auto times = listOnce(lister, path);
        if (times.count != static_cast<std::size_t>(state.range(0)))
            state.SkipWithError("the list is not whole");
        state.SetIterationTime(times.complete / 1000);
        complete.push_back(times.complete);
        firstRows.push_back(times.firstRows);
        floors.push_back(floorOnce(path));
    }
    state.counters["ready_ms"] = median(complete);
    state.counters["first_ms"] = median(firstRows);
    state.counters["floor_ms"] = median(floors);
    state.counters["x_floor"] = median(complete) / median(floors);
}
BENCHMARK(listFolder)->Arg(1'000)->Arg(10'000)->Arg(100'000)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Measures the part of the list's work that one thread does for each name: its kind and its sort key.
void classifyAndKey(benchmark::State& state)
{
    const host::system::EntryClassifier classifier(std::make_shared<host::system::MimeTypeRegistry>());
    const host::system::NameOrder order("en_US");
    std::vector<std::uint8_t> keys;
    for (auto _ : state) {
        keys.clear();
        const auto entry =
            classifier.classify("Minutes of the meeting 2024.txt", platform::FileType::Regular);
        order.appendKey(entry->name, keys);
        benchmark::DoNotOptimize(keys.data());
    }
}
BENCHMARK(classifyAndKey);

void typeOfKnownExtension(benchmark::State& state)
{
    const host::system::MimeTypeRegistry types;
    for (auto _ : state)
        benchmark::DoNotOptimize(types.typeForExtension("JPG"));
}
BENCHMARK(typeOfKnownExtension);

void typeOfOtherExtension(benchmark::State& state)
{
    const host::system::MimeTypeRegistry types;
    for (auto _ : state)
        benchmark::DoNotOptimize(types.typeForExtension("scala"));
}
BENCHMARK(typeOfOtherExtension);

} // namespace

BENCHMARK_MAIN();
