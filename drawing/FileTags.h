// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Color.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tarrow {

/// The tags that the account's devices share: their names in the user's order, and their colours. The table
/// is read at the first question, and again whenever the key-value store says that it has changed; nobody
/// else is told of such a change. Any thread, except that the first call must come from the main thread.
class FileTags {
public:
    using ColorsByTag = std::map<std::string, platform::Color, std::less<>>;

    FileTags() = delete;

    /// Answers the colour of one tag without copying the table, and nothing for a name that it does not hold.
    static std::optional<platform::Color> colorOfTag(std::string_view name);
    /// Answers a copy of the table's colours. A name that occurs twice in the table has the later colour.
    static ColorsByTag tagColorsByTag();
    /// Answers a copy of the table's names in its order; a name that occurs twice is answered twice.
    static std::vector<std::string> allTags();

    /// Answers the colours from which a table's entries choose by their index; 0 means a tag without a
    /// colour.
    static const std::array<platform::Color, 8>& _tagBlipColors();
    /// Reads the table from the key-value store. A table whose version is not 2 counts as empty. An entry
    /// without a name is left out, and an index beyond the colours counts as 0.
    static void _tagColorsDidChange();
};

} // namespace tarrow
