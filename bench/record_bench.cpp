// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures reading an item into its record, beside the system calls that it cannot do without: for a
// local file one statx and one getxattr, for a promise one statx that fails and one read of the promise's
// file.

#include "host/drive/records/PromiseRecord.h"
#include "host/drive/service/LocalCloudDocumentService.h"
#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/queues/GLibDispatch.h"
#include "host/system/texts/IcuFormatters.h"
#include "items/DRItem.h"
#include "platform/NotificationCenter.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <filesystem>
#include <fstream>

namespace {

using host::drive::PromiseRecord;
using platform::Url;

constexpr int itemCount = 64;

/// A drive with local files and promises, and the services that a record calls.
class Drive {
public:
    Drive()
    {
        const auto layout = host::drive::DriveLayout::at(_home);
        platform::ServiceSet set;
        set.dispatch = std::make_shared<host::system::GLibDispatch>();
        set.notificationCenter = std::make_shared<platform::NotificationCenter>();
        set.fileCoordinator = std::make_shared<host::system::LocalFileCoordinator>();
        set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
        set.formatters = std::make_shared<host::system::IcuFormatters>("en_US");
        set.typeRegistry = std::make_shared<host::system::MimeTypeRegistry>();
        set.previewSupport = std::make_shared<host::system::TypePreviewSupport>(set.typeRegistry);
        set.cloudDocumentService = host::drive::LocalCloudDocumentService::create(layout,
            {set.dispatch, set.notificationCenter, set.typeRegistry, nullptr, nullptr},
            {.languages = {"en"}});
        platform::installServices(std::move(set));
        for (int i = 0; i < itemCount; ++i)
            addItems(std::to_string(i));
    }
    ~Drive()
    {
        platform::installServices({});
        std::filesystem::remove_all(_home);
    }

    std::vector<Url> files, promises;

private:
    static std::string makeHome()
    {
        auto pattern = (std::filesystem::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        return std::filesystem::canonical(mkdtemp(pattern.data())).string();
    }

    void addItems(const std::string& number)
    {
        const auto folder = _home + "/documents/BrindleDefault/Documents/Letters";
        std::filesystem::create_directories(folder);
        const auto file = folder + "/Letter " + number + ".txt";
        std::ofstream(file) << "content";
        files.push_back(Url::fileURL(file));
        PromiseRecord promise;
        promise.size = 12345;
        promise.created = promise.modified = platform::Date::fromSeconds(1e9);
        const auto item = folder + "/Promised letter " + number + ".txt";
        std::ofstream(PromiseRecord::pathFor(item)) << promise.toJson();
        promises.push_back(Url::fileURL(item));
    }

    std::string _home = makeHome();
};

void lookAtStatus(const std::string& path)
{
    struct statx status;
    benchmark::DoNotOptimize(::statx(AT_FDCWD, path.c_str(), AT_SYMLINK_NOFOLLOW | AT_STATX_DONT_SYNC,
        STATX_BASIC_STATS | STATX_BTIME, &status));
}

void floorOfFile(const std::string& path)
{
    std::array<char, 256> buffer;
    lookAtStatus(path);
    benchmark::DoNotOptimize(::getxattr(path.c_str(), "user.tarrow.status", buffer.data(), buffer.size()));
}

void floorOfPromise(const std::string& path)
{
    std::array<char, 4096> buffer;
    lookAtStatus(path);
    const int file = ::open(PromiseRecord::pathFor(path).c_str(), O_RDONLY | O_CLOEXEC);
    benchmark::DoNotOptimize(::read(file, buffer.data(), buffer.size()));
    ::close(file);
}

using Clock = std::chrono::steady_clock;

double median(std::vector<double>& times)
{
    const auto middle = times.begin() + static_cast<std::ptrdiff_t>(times.size() / 2);
    std::ranges::nth_element(times, middle);
    return *middle;
}

/// Runs the floor and the reading in turn over all items, so that both run under the same load, and compares
/// the medians.
void compare(benchmark::State& state, const std::vector<Url>& urls, void (*floor)(const std::string&))
{
    std::vector<double> floorTimes, readTimes;
    const auto nanosecondsForEach = [&](Clock::duration time) {
        return std::chrono::duration<double, std::nano>(time).count() / static_cast<double>(urls.size());
    };
    for (auto _ : state) {
        const auto begin = Clock::now();
        for (const auto& url : urls)
            floor(url.path());
        const auto middle = Clock::now();
        for (const auto& url : urls)
            benchmark::DoNotOptimize(tarrow::DRItem::initWithURL(url));
        const auto end = Clock::now();
        floorTimes.push_back(nanosecondsForEach(middle - begin));
        readTimes.push_back(nanosecondsForEach(end - middle));
        state.SetIterationTime(std::chrono::duration<double>(end - middle).count());
    }
    state.counters["floor_ns"] = median(floorTimes);
    state.counters["record_ns"] = median(readTimes);
    state.counters["ratio"] = median(readTimes) / median(floorTimes);
}

void recordOfLocalFile(benchmark::State& state)
{
    const Drive drive;
    compare(state, drive.files, floorOfFile);
}
BENCHMARK(recordOfLocalFile)->UseManualTime();

void recordOfPromise(benchmark::State& state)
{
    const Drive drive;
    compare(state, drive.promises, floorOfPromise);
}
BENCHMARK(recordOfPromise)->UseManualTime();

} // namespace

BENCHMARK_MAIN();
