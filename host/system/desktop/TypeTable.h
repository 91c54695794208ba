// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <span>
#include <string_view>

namespace host::system {

/// One kind of item that has an identifier of its own. Lists are separated by blanks.
struct TypeRow {
    std::string_view identifier;
    std::string_view parents; ///< identifiers that it is a kind of
    std::string_view mimeTypes; ///< of the shared MIME database, the preferred one first
    std::string_view extensions; ///< in lower case; an extension stands in one row only
};

/// All of them, parents before their kinds.
std::span<const TypeRow> typeTable();

} // namespace host::system
