// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/search/NameIndex.h"
#include "host/system/texts/NameFolding.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace host::system {

/// The tags of the items of a name index, as they were when each item was looked at. Only items with tags
/// take memory. Immutable; any thread.
class TagIndex {
public:
    /// Answers the tags of the item at a path, or of its promise; it follows no link, and answers none for
    /// what cannot be read. Any thread.
    using Reader = std::function<std::vector<std::string>(const std::string& path, bool isPromise)>;

    /// Looks at every item of an index, which costs a system call or two for each. When `isCancelled` answers
    /// true, which is asked every few thousand items, the rest is left out.
    static TagIndex gather(std::shared_ptr<const NameIndex> names, const Reader& reader,
        const NameFolding& folding, const std::function<bool()>& isCancelled);

    /// Answers the items with a tag that begins with a folded text; those with just this tag come first.
    NameIndex::Found find(std::string_view foldedTag, std::size_t limit) const;
    /// The index to which the items' numbers belong.
    const NameIndex& names() const { return *_names; }

private:
    struct Tagged {
        std::uint32_t item;
        std::string foldedTags; ///< each tag behind a zero byte
    };

    std::shared_ptr<const NameIndex> _names;
    std::vector<Tagged> _tagged;
};

} // namespace host::system
