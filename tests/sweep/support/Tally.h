// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace sweep_tests {

/// What this process has tried. It is printed at the end, in a line that tools/sweep-figures adds up.
struct Tally {
    int kills = 0, errors = 0, pairs = 0, deeds = 0, powerCuts = 0;
};
Tally& tally();

} // namespace sweep_tests
