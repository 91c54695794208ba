// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Answers bytes as text for people. Bytes that are not UTF-8 become replacement characters.
std::string displayableText(std::string_view bytes);

} // namespace host::system
