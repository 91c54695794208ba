// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures what items that are not downloaded cost: evicting and downloading documents beside copying
// them (also synced one by one, as a download is), and the room that promises take on the disk. The argument
// is the number of documents.

#include "host/drive/changes/DownloadWork.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/PromiseFile.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fstream>

namespace {

namespace fs = std::filesystem;

using host::drive::DriveLayout;
using host::drive::PromiseRecord;
using host::system::FileDescriptor;

class Drive {
public:
    explicit Drive(int count)
    {
        fs::create_directories(_layout.defaultContainer());
        fs::create_directories(_layout.cloud());
        for (int i = 0; i < count; ++i) {
            paths.push_back(_layout.defaultContainer() + "/Letter " + std::to_string(i) + ".txt");
            std::ofstream(paths.back()) << std::string(4000, 'x');
        }
    }
    ~Drive() { fs::remove_all(_layout.home()); }
    Drive(const Drive&) = delete;
    Drive& operator=(const Drive&) = delete;

    const DriveLayout& layout() const { return _layout; }
    std::vector<std::string> paths;

private:
    static std::string makeHome()
    {
        auto pattern = (fs::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        return fs::canonical(mkdtemp(pattern.data())).string();
    }
    const DriveLayout _layout = DriveLayout::at(makeHome()).prepare();
};

void copying(benchmark::State& state)
{
    const Drive drive(static_cast<int>(state.range(0)));
    const auto folder = host::drive::openOwnFolder(drive.layout().defaultContainer());
    const auto target = host::drive::openOwnFolder(drive.layout().home() + "/copies");
    for (auto _ : state) {
        for (const auto& path : drive.paths) {
            const auto name = fs::path(path).filename().string();
            if (host::drive::copyTree(*folder, name, *target, name) || host::drive::syncFolder(*target))
                state.SkipWithError("a document could not be copied");
        }
    }
}

void evictingAndDownloading(benchmark::State& state)
{
    const Drive drive(static_cast<int>(state.range(0)));
    const auto store = std::make_shared<host::drive::LocalCloudStore>(drive.layout());
    host::drive::LocalItemChanges changes(drive.layout(), store);
    const auto goOn = [](auto, auto) { return host::drive::CloudStore::Continue::Yes; };
    const auto alone = [](const auto& steps) {
        steps();
        return std::optional<platform::Error>();
    };
    for (auto _ : state) {
        for (const auto& path : drive.paths) {
            if (changes.evictItem(path) || host::drive::bringHere(drive.layout(), *store, path, goOn, alone))
                state.SkipWithError("a document could not be evicted or downloaded");
        }
    }
}

void roomOfPromises(benchmark::State& state)
{
    Drive drive(0);
    PromiseRecord promise;
    promise.size = 4000;
    promise.created = promise.modified = platform::Date{1'600'000'000'000'000'000};
    promise.documentIdentifier = 42;
    promise.content = "c-3f2a-6923f1a22f3b4c5d-3e8f";
    std::uint64_t blocks = 0;
    for (auto _ : state) {
        for (int i = 0; i < state.range(0); ++i) {
            const auto path = PromiseRecord::pathFor(
                drive.layout().defaultContainer() + "/Letter " + std::to_string(i) + ".txt");
            const FileDescriptor file(::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644));
            struct stat found;
            if (host::drive::writePromise(file, promise) || ::fstat(file.get(), &found) != 0)
                state.SkipWithError("a promise could not be written");
            blocks += static_cast<std::uint64_t>(found.st_blocks);
        }
    }
    struct stat folder;
    ::stat(drive.layout().defaultContainer().c_str(), &folder);
    state.counters["bytes"] = static_cast<double>(blocks * 512 + static_cast<std::uint64_t>(folder.st_size));
}

BENCHMARK(copying)->Arg(10'000)->Iterations(1)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(evictingAndDownloading)->Arg(10'000)->Iterations(1)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(roomOfPromises)->Arg(100'000)->Iterations(1)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
