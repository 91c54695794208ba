// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <memory>
#include <shared_mutex>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace host::system {

struct TypeRow;

/// Allows a look-up in a map of texts without making a text.
struct TextHash {
    using is_transparent = void;
    std::size_t operator()(std::string_view text) const { return std::hash<std::string_view>()(text); }
};
template <typename T>
using TextMap = std::unordered_map<std::string, T, TextHash, std::equal_to<>>;

/// Answers which type is a kind of which. Any thread.
class TypeGraph {
public:
    static constexpr std::string_view dynamicPrefix = "dyn.mime.";

    TypeGraph();

    /// Answers the table's row of a type, or null for a type that is not in the table.
    const TypeRow* row(std::string_view type) const;
    /// Answers the table's row of a MIME type, or null when there is none.
    const TypeRow* rowOfMimeType(std::string_view mimeType) const;
    const TypeRow* rowOfExtension(std::string_view extension) const;

    bool conformsTo(std::string_view type, std::string_view other) const;

private:
    using Ancestors = std::vector<std::string>;
    Ancestors ancestorsOfRow(const TypeRow& row) const;
    Ancestors ancestorsOfDynamic(std::string_view mimeType) const;
    std::shared_ptr<const Ancestors> dynamicAncestors(std::string_view type) const;

    TextMap<const TypeRow*> _rows, _byMimeType, _byExtension;
    TextMap<Ancestors> _ancestors;
    mutable std::shared_mutex _mutex;
    mutable TextMap<std::shared_ptr<const Ancestors>> _dynamic;
};

/// Answers the parts of a list that is separated by blanks.
std::vector<std::string_view> words(std::string_view list);

} // namespace host::system
