// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <vector>

namespace testing_support {

/// Answers the warnings that the toolkit and its libraries have written since the last call.
std::vector<std::string> takeToolkitWarnings();

} // namespace testing_support
