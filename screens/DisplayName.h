// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace screens {

/// Answers a file name as text for the screen. Bytes that are not UTF-8 become the replacement character. So
/// do the characters that change the direction of text, because they could disguise an extension. Control
/// characters become a blank.
std::string displayName(std::string_view bytes);

/// Answers the extension of a name without its dot, or an empty text when it has none.
std::string_view nameExtension(std::string_view name);

} // namespace screens
