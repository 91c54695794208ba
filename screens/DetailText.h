// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace screens {

/// Answers two parts of a line of details in the order and with the separator of the user's language, such as
/// "Nov 23, 2026 · 5 KB". An empty part is left out, and the separator with it.
std::string joinedDetails(const std::string& first, const std::string& second);

/// Answers a folder and one inside it as a place, such as "Documents › Letters". An empty part is left out as
/// above.
std::string joinedPlace(const std::string& folder, const std::string& inner);

} // namespace screens
