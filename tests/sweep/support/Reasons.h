// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "tests/sweep/support/FaultyRun.h"

#include <string>

namespace sweep_tests {

/// Answers what is wrong with the reason that a program gives for its failure after a call met this error;
/// empty when the reason is right. It is right when the sentence for the user says what this error means, and
/// the code is the error's number, or that of a change that was given up.
std::string faultOfReason(const Ending& ending, int errorNumber);

} // namespace sweep_tests
