// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Color.h"

#include <array>
#include <map>
#include <string>
#include <vector>

namespace tarrow {

/// The tags that the account's devices share: their names, in the person's order, and their colours. The
/// table is read when it is asked for first and again whenever the key-value store says that it has changed;
/// nobody else is told of that. Any thread, but for the first call, which must come from the main thread.
class FileTags {
public:
    using ColorsByTag = std::map<std::string, platform::Color, std::less<>>;

    FileTags() = delete;

    /// A copy of the table's colours. A name that stands in the table twice has the later colour.
    static ColorsByTag tagColorsByTag();
    /// A copy of the table's names, in its order, with those that stand in it twice.
    static std::vector<std::string> allTags();

    /// The colours that a table's entries choose from by their index; 0 is that of a tag without a colour.
    static const std::array<platform::Color, 8>& _tagBlipColors();
    /// Reads the table from the key-value store. One of another version than 2 counts as empty; an entry
    /// without a name is left out; an index beyond the colours counts as 0.
    static void _tagColorsDidChange();
};

} // namespace tarrow
