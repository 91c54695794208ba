// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <span>
#include <string_view>

namespace host::system {

/// One type that has an identifier of its own. Lists are separated by blanks.
struct TypeRow {
    std::string_view identifier;
    std::string_view parents; ///< identifiers of the types of which it is a kind
    std::string_view mimeTypes; ///< names in the shared MIME database, the preferred one first
    std::string_view extensions; ///< in lower case; each extension stands in one row only
};

/// Answers all rows, parents before their kinds.
std::span<const TypeRow> typeTable();

} // namespace host::system
