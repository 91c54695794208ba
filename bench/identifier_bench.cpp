// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures finding a document by its identifier, beside the least that it takes: one database query, one
// open and one read of the attribute. The argument is the number of documents with an identifier; they are
// looked up in an order unrelated to their places.

#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/ItemFacts.h"
#include "host/system/queues/GLibDispatch.h"

#include <fcntl.h>
#include <sqlite3.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <random>

namespace {

using host::drive::LocalDocumentIdentifiers;
using platform::Url;
using Clock = std::chrono::steady_clock;

constexpr std::size_t lookUpsInTurn = 64;

class Drive {
public:
    explicit Drive(int count)
    {
        const auto folder = _home + "/documents/BrindleDefault/Documents/Letters";
        std::filesystem::create_directories(folder);
        for (int i = 0; i < count; ++i) {
            const auto path = folder + "/Letter " + std::to_string(i) + ".txt";
            std::ofstream(path) << "content";
            known.push_back(identifiers->identify(Url::fileURL(path)).value.value());
        }
        std::ranges::shuffle(known, std::mt19937(1));
    }
    ~Drive() { std::filesystem::remove_all(_home); }

private:
    static std::string makeHome()
    {
        auto pattern = (std::filesystem::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        return std::filesystem::canonical(mkdtemp(pattern.data())).string();
    }

    std::string _home = makeHome();
    host::drive::DriveLayout _layout = host::drive::DriveLayout::at(_home);

public:
    const std::string& home() const { return _home; }
    std::shared_ptr<host::system::GLibDispatch> dispatch = std::make_shared<host::system::GLibDispatch>();
    std::shared_ptr<LocalDocumentIdentifiers> identifiers =
        LocalDocumentIdentifiers::create(_layout, dispatch);
    std::vector<std::uint32_t> known;
};

/// The floor's own connection, which is opened and prepared once.
class Floor {
public:
    explicit Floor(const std::string& home)
        : _home(home + '/')
    {
        sqlite3_open_v2((_home + "index.sqlite").c_str(), &_database, SQLITE_OPEN_READWRITE, nullptr);
        sqlite3_prepare_v2(
            _database, "SELECT path FROM documents WHERE identifier = ?", -1, &_query, nullptr);
    }
    ~Floor()
    {
        sqlite3_finalize(_query);
        sqlite3_close(_database);
    }
    void lookUp(std::uint32_t identifier)
    {
        sqlite3_bind_int64(_query, 1, identifier);
        if (sqlite3_step(_query) != SQLITE_ROW)
            std::abort();
        const std::string path = _home
            + std::string(static_cast<const char*>(sqlite3_column_blob(_query, 0)),
                static_cast<std::size_t>(sqlite3_column_bytes(_query, 0)));
        sqlite3_reset(_query);
        std::array<char, 32> value;
        const int file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
        if (::fgetxattr(file, host::drive::itemMark::documentIdentifier, value.data(), value.size()) <= 0)
            std::abort();
        ::close(file);
    }

private:
    std::string _home;
    sqlite3* _database = nullptr;
    sqlite3_stmt* _query = nullptr;
};

void lookUp(LocalDocumentIdentifiers& identifiers, std::uint32_t identifier)
{
    const auto file = identifiers.resolve(identifier);
    const auto found = (*identifiers.open(*file))->attributes();
    if (found->documentIdentifier != identifier)
        std::abort();
}

double median(std::vector<double>& times)
{
    const auto middle = times.begin() + static_cast<std::ptrdiff_t>(times.size() / 2);
    std::ranges::nth_element(times, middle);
    return *middle;
}

void documentByIdentifier(benchmark::State& state)
{
    const Drive drive(static_cast<int>(state.range(0)));
    Floor floor(drive.home());
    std::vector<double> floorTimes, times;
    const auto each = [](Clock::duration time) {
        return std::chrono::duration<double, std::nano>(time).count() / static_cast<double>(lookUpsInTurn);
    };
    std::size_t at = 0;
    for (auto _ : state) {
        const auto next = [&](std::size_t i) { return drive.known[(at + i) % drive.known.size()]; };
        const auto begin = Clock::now();
        for (std::size_t i = 0; i < lookUpsInTurn; ++i)
            floor.lookUp(next(i));
        const auto middle = Clock::now();
        for (std::size_t i = 0; i < lookUpsInTurn; ++i)
            lookUp(*drive.identifiers, next(i));
        const auto end = Clock::now();
        floorTimes.push_back(each(middle - begin));
        times.push_back(each(end - middle));
        state.SetIterationTime(std::chrono::duration<double>(end - middle).count());
        at += lookUpsInTurn;
    }
    state.counters["floor_ns"] = median(floorTimes);
    state.counters["found_ns"] = median(times);
    state.counters["ratio"] = median(times) / median(floorTimes);
}
BENCHMARK(documentByIdentifier)->Arg(100)->Arg(5000)->UseManualTime();

} // namespace

BENCHMARK_MAIN();
