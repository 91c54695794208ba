// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace screens {

/// Two parts of a line of details in the order and with the mark that the language has for it, such as
/// "Nov 23, 2026 · 5 KB". An empty part and the mark are left out.
std::string joinedDetails(const std::string& first, const std::string& second);

/// A folder and one in it as a place, such as "Documents › Letters". Empty ones as above.
std::string joinedPlace(const std::string& folder, const std::string& inner);

} // namespace screens
