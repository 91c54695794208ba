// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/EntryClassifier.h"

#include <benchmark/benchmark.h>
#include <gio/gio.h>

#include <memory>
#include <string>
#include <vector>

namespace {

constexpr std::size_t count = 100'000;

/// Answers names like those that people use: some extensions often, some once, some names without any.
const std::vector<std::string>& names()
{
    static const auto all = [] {
        constexpr const char* extensions[] = {
            ".txt", ".pdf", ".jpg", ".png", ".odt", ".tar.gz", ".mp4", ".xyz", "", ".JPG"};
        std::vector<std::string> made;
        made.reserve(count);
        for (std::size_t number = 0; number < count; ++number)
            made.push_back("Document " + std::to_string(number) + extensions[number % std::size(extensions)]);
        return made;
    }();
    return all;
}

/// Measures the floor, the library's own guess by the name.
void guess(benchmark::State& state)
{
    for (auto each : state) {
        for (const auto& name : names()) {
            gchar* type = g_content_type_guess(name.c_str(), nullptr, 0, nullptr);
            benchmark::DoNotOptimize(type);
            g_free(type);
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(count));
}
BENCHMARK(guess)->Unit(benchmark::kMillisecond);

void classify(benchmark::State& state)
{
    const host::system::EntryClassifier classifier(std::make_shared<host::system::MimeTypeRegistry>());
    for (auto each : state) {
        for (const auto& name : names())
            benchmark::DoNotOptimize(classifier.classify(name, platform::FileType::Regular));
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(count));
}
BENCHMARK(classify)->Unit(benchmark::kMillisecond);

/// Measures the type of each name's extension.
void typeOfExtension(benchmark::State& state)
{
    const host::system::MimeTypeRegistry types;
    for (auto each : state) {
        for (const auto& name : names()) {
            const auto dot = name.rfind('.');
            benchmark::DoNotOptimize(types.typeForExtension(
                dot == std::string::npos ? std::string_view() : std::string_view(name).substr(dot + 1)));
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(count));
}
BENCHMARK(typeOfExtension)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
