// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace host::system {

/// The name of the program's message catalogue.
inline constexpr const char* textDomain = "tarrow-drive";

/// Answers a text of the host itself in the user's language, or the key when the catalogue has none. Any
/// thread.
std::string translated(const char* key);

/// Marks a text in a table that is looked up later, for the check of the catalogues.
constexpr const char* textKey(const char* key)
{
    return key;
}

} // namespace host::system
