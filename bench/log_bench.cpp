// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures a log call at a disabled level, beside the loop around it.

#include "platform/Log.h"

#include <benchmark/benchmark.h>

namespace {

void emptyLoop(benchmark::State& state)
{
    int value = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(++value);
}
BENCHMARK(emptyLoop);

void disabledLogCall(benchmark::State& state)
{
    static constexpr platform::Operation op{"-[Bench disabledLogCall]"};
    platform::setLogLevel(platform::LogLevel::Warning);
    const auto url = platform::Url::fileURL("/a/document.txt");
    int value = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(++value);
        op.debug("Value %d of %@", value, url);
    }
}
BENCHMARK(disabledLogCall);

} // namespace

BENCHMARK_MAIN();
