// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/search/TagIndex.h"

#include <algorithm>
#include <utility>

namespace host::system {

namespace {

constexpr std::size_t cancelEvery = 4096; ///< items

enum class Match { None, Beginning, Whole };

Match matchOf(std::string_view foldedTags, const std::string& separatedTag)
{
    Match best = Match::None;
    for (auto at = foldedTags.find(separatedTag); at != std::string_view::npos;
         at = foldedTags.find(separatedTag, at + 1)) {
        const auto end = at + separatedTag.size();
        if (end == foldedTags.size() || foldedTags[end] == '\0')
            return Match::Whole;
        best = Match::Beginning;
    }
    return best;
}

} // namespace

TagIndex TagIndex::gather(std::shared_ptr<const NameIndex> names, const Reader& reader,
    const NameFolding& folding, const std::function<bool()>& isCancelled)
{
    TagIndex index;
    index._names = std::move(names);
    for (const auto& folder : index._names->folders()) {
        for (auto number = folder.firstItem; number < folder.firstItem + folder.itemCount; ++number) {
            if (number % cancelEvery == 0 && isCancelled())
                return index;
            const auto item = index._names->item(number);
            Tagged tagged{number, {}};
            for (const auto& tag : reader((folder.path + '/').append(item.name), item.isPromise)) {
                tagged.foldedTags += '\0';
                folding.append(tag, tagged.foldedTags);
            }
            if (!tagged.foldedTags.empty())
                index._tagged.push_back(std::move(tagged));
        }
    }
    return index;
}

NameIndex::Found TagIndex::find(std::string_view foldedTag, std::size_t limit) const
{
    const auto separated = '\0' + std::string(foldedTag);
    std::vector<std::uint32_t> whole, beginning;
    for (const auto& tagged : _tagged) {
        const auto match = matchOf(tagged.foldedTags, separated);
        if (match != Match::None)
            (match == Match::Whole ? whole : beginning).push_back(tagged.item);
    }
    NameIndex::Found found{std::move(whole), 0};
    found.items.insert(found.items.end(), beginning.begin(), beginning.end());
    found.total = found.items.size();
    found.items.resize(std::min(found.items.size(), limit));
    return found;
}

} // namespace host::system
