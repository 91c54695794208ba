// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures a coordinated move that nobody else waits for, beside the bare rename. The difference is the
// cost of coordination, which may be up to 20 microseconds.

#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/queues/GLibDispatch.h"
#include "platform/FilePresenter.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>

namespace {

using host::system::LocalFileCoordinator;
using platform::Url;
using platform::WritingOptions;
using Clock = std::chrono::steady_clock;

/// A document two folders below a drive's top level, and its second name.
class Drive {
public:
    Drive()
    {
        std::filesystem::create_directories(_folder);
        std::ofstream(document.path()) << "content";
    }
    ~Drive() { std::filesystem::remove_all(_home); }

    LocalFileCoordinator::Settings settings() const
    {
        return {
            .lockFile = _home + "/locks/coordination", .root = _home + "/documents", .dispatch = dispatch};
    }

private:
    static std::string makeHome()
    {
        auto pattern = (std::filesystem::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        return std::filesystem::canonical(mkdtemp(pattern.data())).string();
    }
    std::string _home = makeHome();
    std::string _folder = _home + "/documents/BrindleDefault/Documents/Letters/2023";

public:
    const std::shared_ptr<platform::Dispatch> dispatch = std::make_shared<host::system::GLibDispatch>();
    const Url document = Url::fileURL(_folder + "/Letter.txt");
    const Url renamed = Url::fileURL(_folder + "/Other letter.txt");
};

class Presenter : public platform::FilePresenter {
public:
    Presenter(Url url, const std::shared_ptr<platform::Dispatch>& dispatch)
        : _url(std::move(url))
        , _queue(dispatch->makeOperationQueue("presenter", platform::QualityOfService::Utility))
    {
    }
    std::optional<Url> presentedItemURL() override { return _url; }
    std::shared_ptr<platform::OperationQueue> presentedItemOperationQueue() override { return _queue; }

private:
    Url _url;
    std::shared_ptr<platform::OperationQueue> _queue;
};

void moveBare(const Url& from, const Url& to)
{
    benchmark::DoNotOptimize(std::rename(from.path().c_str(), to.path().c_str()));
}

std::optional<platform::Error> moveCoordinated(
    LocalFileCoordinator& coordinator, const Url& source, const Url& target)
{
    return coordinator.coordinateWriting(source, WritingOptions::ForMoving, target,
        WritingOptions::ForReplacing, [&](const Url& from, const Url& to) {
            coordinator.itemWillMove(from, to);
            moveBare(from, to);
            coordinator.itemDidMove(from, to);
        });
}

double median(std::vector<double>& times)
{
    const auto middle = times.begin() + static_cast<std::ptrdiff_t>(times.size() / 2);
    std::ranges::nth_element(times, middle);
    return *middle;
}

/// Moves back and forth, bare and coordinated in turn, so that both run under the same load, and compares the
/// medians.
void compare(benchmark::State& state, const Drive& drive, LocalFileCoordinator& coordinator)
{
    const auto microseconds = [](Clock::duration time) {
        return std::chrono::duration<double, std::micro>(time).count() / 2;
    };
    std::vector<double> bare, coordinated;
    for (auto _ : state) {
        const auto begin = Clock::now();
        moveBare(drive.document, drive.renamed);
        moveBare(drive.renamed, drive.document);
        const auto middle = Clock::now();
        const auto failed = moveCoordinated(coordinator, drive.document, drive.renamed);
        const auto failedBack = moveCoordinated(coordinator, drive.renamed, drive.document);
        const auto end = Clock::now();
        if (failed || failedBack)
            return state.SkipWithError("not coordinated");
        bare.push_back(microseconds(middle - begin));
        coordinated.push_back(microseconds(end - middle));
        state.SetIterationTime(std::chrono::duration<double>(end - middle).count());
    }
    state.counters["bare_us"] = median(bare);
    state.counters["coordinated_us"] = median(coordinated);
    state.counters["over_us"] = median(coordinated) - median(bare);
    state.counters["ratio"] = median(coordinated) / median(bare);
}

void moveWithoutPresenters(benchmark::State& state)
{
    const Drive drive;
    LocalFileCoordinator coordinator(drive.settings());
    compare(state, drive, coordinator);
}
BENCHMARK(moveWithoutPresenters)->UseManualTime();

void moveWhileAnotherItemIsPresented(benchmark::State& state)
{
    const Drive drive;
    LocalFileCoordinator coordinator(drive.settings());
    const auto other = drive.document.deletingLastPathComponent().appendingPathComponent("Presented.txt");
    std::ofstream(other.path()) << "content";
    const auto presenter = std::make_shared<Presenter>(other, drive.dispatch);
    coordinator.addFilePresenter(presenter);
    compare(state, drive, coordinator);
    coordinator.removeFilePresenter(*presenter);
}
BENCHMARK(moveWhileAnotherItemIsPresented)->UseManualTime();

} // namespace

BENCHMARK_MAIN();
