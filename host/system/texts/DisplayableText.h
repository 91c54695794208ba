// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace host::system {

/// Bytes as text for people: what is no UTF-8 becomes replacement characters.
std::string displayableText(std::string_view bytes);

} // namespace host::system
