// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace platform {

/// Answers the name of an item's n-th copy, which lies beside it: "Plan.pdf" becomes "Plan 2.pdf". The first
/// one is the name itself. Of a long name the end before the extension is left out, whole characters, so that
/// the answer has at most 255 bytes. Names are bytes.
std::string copyName(const std::string& name, int number);

/// Answers UTF-8 without an incomplete character at its end.
std::string_view withoutCutCharacter(std::string_view bytes);

} // namespace platform
