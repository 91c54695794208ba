// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/Tally.h"

#include <gtest/gtest.h>

#include <cstdio>

namespace sweep_tests {

namespace {

class Printing : public testing::Environment {
public:
    void TearDown() override
    {
        const auto& all = tally();
        std::printf("Tried: %d kills, %d errors, %d pairs, %d deeds, %d power cuts\n", all.kills, all.errors,
            all.pairs, all.deeds, all.powerCuts);
    }
};

[[maybe_unused]] const auto* const printing = testing::AddGlobalTestEnvironment(new Printing);

} // namespace

Tally& tally()
{
    static Tally instance;
    return instance;
}

} // namespace sweep_tests
