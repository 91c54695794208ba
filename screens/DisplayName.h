// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace screens {

/// A file name as text for the screen: bytes that are no UTF-8 show as the replacement character, as does
/// what turns the direction of the text and so could disguise an extension; control characters show as a
/// blank.
std::string displayName(std::string_view bytes);

/// The extension of a name without its dot; empty for none.
std::string_view nameExtension(std::string_view name);

} // namespace screens
