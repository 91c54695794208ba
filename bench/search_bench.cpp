// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures a search over a million names while the query is typed, beside its floor: one scan of the
// packed folded names for the same text that skips from hit to hit and counts the names. It prints the ratio
// as "x_floor", the number of hits, and the memory for each item.
//
// "gathering" reads the names of a real tree of 100,000 items (made under TMPDIR) and brings an index of it
// up to date when nothing has changed. Its floor is a walk that reads the same folders and keeps nothing.

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/DirectoryReader.h"
#include "host/system/search/NameGathering.h"

#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <random>

namespace {

using Clock = std::chrono::steady_clock;
using host::system::NameFolding;
using host::system::NameIndex;

constexpr std::size_t millionItems = 1'000'000;
constexpr const char* stems[] = {"Report", "holiday photo", "Invoice", "notes from the meeting", "IMG",
    "Budget", "Präsentation", "scan", "letter to the bank", "recipe"};
constexpr const char* endings[] = {".txt", ".pdf", ".jpg", ".odt", ".png"};

std::string nameOf(std::size_t number, std::minstd_rand& random)
{
    return std::string(stems[random() % std::size(stems)]) + ' ' + std::to_string(number)
        + endings[random() % std::size(endings)];
}

const NameIndex& index()
{
    static const NameIndex made = [] {
        const NameFolding folding;
        NameIndex::Builder builder;
        std::minstd_rand random(7);
        for (std::size_t i = 0; i < millionItems; ++i) {
            if (i % 100 == 0)
                builder.beginFolder("/home/person/drive/documents/folder " + std::to_string(i / 100), 1);
            const auto name = nameOf(i, random);
            std::string folded;
            folding.append(name, folded);
            builder.append({name, folded, platform::FolderEntryKind::Document, false});
        }
        return builder.finish();
    }();
    return made;
}

/// Counts the names that contain a text, by scanning alone.
std::size_t scan(std::string_view names, std::string_view text)
{
    std::size_t count = 0;
    const char* place = names.data();
    const char* const end = names.data() + names.size();
    while ((place = static_cast<const char*>(
                ::memmem(place, static_cast<std::size_t>(end - place), text.data(), text.size())))) {
        ++count;
        place = static_cast<const char*>(std::memchr(place, '\0', static_cast<std::size_t>(end - place)));
        if (!place)
            break;
    }
    return count;
}

double seconds(Clock::duration duration)
{
    return std::chrono::duration<double>(duration).count();
}

void search(benchmark::State& state, const char* query)
{
    const auto& names = index();
    // A search looks for the longest of several words first, which here is the first one.
    const auto firstWord = std::string_view(query).substr(0, std::string_view(query).find(' '));
    double found = 0, floor = 0;
    std::size_t total = 0;
    for (auto _ : state) {
        const auto start = Clock::now();
        const auto result = names.find(query, platform::NameSearch::shownItems, {});
        for (const auto number : result.items)
            benchmark::DoNotOptimize(names.found(number));
        const auto middle = Clock::now();
        const auto counted = scan(names.foldedNames(), firstWord);
        floor += seconds(Clock::now() - middle);
        found += seconds(middle - start);
        state.SetIterationTime(seconds(middle - start));
        total = result.total;
        if (counted != total && firstWord == query)
            state.SkipWithError("the floor found something else");
    }
    state.counters["x_floor"] = found / floor;
    state.counters["floor_ms"] = floor / static_cast<double>(state.iterations()) * 1000;
    state.counters["found"] = static_cast<double>(total);
    state.counters["bytes_per_item"] = static_cast<double>(names.bytes()) / millionItems;
}

/// A tree of 1,000 folders with 100 documents each.
class Tree {
public:
    Tree()
    {
        auto pattern = (std::filesystem::temp_directory_path() / "tarrow-bench-XXXXXX").string();
        if (!mkdtemp(pattern.data()))
            std::abort();
        path = pattern;
        std::minstd_rand random(7);
        for (int folder = 0; folder < 1000; ++folder) {
            const auto place = path + "/folder " + std::to_string(folder);
            std::filesystem::create_directory(place);
            for (std::size_t i = 0; i < 100; ++i)
                std::ofstream(place + '/' + nameOf(i, random));
        }
    }
    ~Tree() { std::filesystem::remove_all(path); }
    std::string path;
};

std::size_t walk(const std::string& path)
{
    std::size_t count = 0;
    const auto folder = host::system::openFolder(path);
    if (!folder)
        return count;
    host::system::DirectoryReader reader(*folder);
    while (const auto entry = reader.next()) {
        ++count;
        if (entry->type == platform::FileType::Directory)
            count += walk(path + '/' + std::string(entry->name));
    }
    return count;
}

void gather(benchmark::State& state, bool again)
{
    static const Tree tree;
    const auto types = std::make_shared<host::system::MimeTypeRegistry>();
    const host::system::EntryClassifier classifier(types);
    const NameFolding folding;
    const auto read = [&](std::shared_ptr<const NameIndex> earlier) {
        host::system::NameGathering gathering(
            classifier, folding, std::move(earlier), {[] { return false; }, [](const NameIndex&) {}});
        return std::make_shared<const NameIndex>(gathering.gather({tree.path}));
    };
    const auto earlier = again ? read(nullptr) : nullptr;
    double gathered = 0, floor = 0;
    for (auto _ : state) {
        const auto start = Clock::now();
        const auto made = read(earlier);
        const auto middle = Clock::now();
        benchmark::DoNotOptimize(walk(tree.path));
        floor += seconds(Clock::now() - middle);
        gathered += seconds(middle - start);
        state.SetIterationTime(seconds(middle - start));
    }
    state.counters["x_floor"] = gathered / floor;
}

} // namespace

// The queries are those of a person who types "report 4217", a letter that occurs nearly everywhere, and a
// text that occurs nowhere.
BENCHMARK_CAPTURE(search, r, "r")->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(search, rep, "rep")->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(search, report_space_4, "report 4")->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(search, digits, "4217")->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(search, nothing, "xylophone")->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(gather, first, false)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(gather, unchanged, true)->UseManualTime()->Unit(benchmark::kMillisecond);

BENCHMARK_MAIN();
