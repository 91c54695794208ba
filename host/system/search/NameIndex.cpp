// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/search/NameIndex.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <limits>
#include <utility>

namespace host::system {

using platform::FolderEntryKind;

namespace {

constexpr std::uint8_t promiseMark = 0x80;
constexpr std::size_t cancelEvery = 4096; ///< items found

std::vector<std::string_view> wordsOf(std::string_view text)
{
    std::vector<std::string_view> words;
    while (!text.empty()) {
        const auto end = std::min(text.find(' '), text.size());
        if (end > 0)
            words.push_back(text.substr(0, end));
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    // The longest word is searched for first, because it occurs least often.
    std::ranges::stable_sort(words, std::ranges::greater(), &std::string_view::size);
    return words;
}

bool isWordCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || static_cast<unsigned char>(c) >= 0x80;
}

/// Answers 0 when the name begins with the text, 1 when a word of it does, and 2 when the text is elsewhere
/// or in parts.
std::size_t rankOf(std::string_view folded, std::string_view query)
{
    const auto place = folded.find(query);
    if (place == 0)
        return 0;
    return place != std::string_view::npos && !isWordCharacter(folded[place - 1]) ? 1 : 2;
}

bool holdsAll(std::string_view folded, const std::vector<std::string_view>& words)
{
    return std::all_of(words.begin() + 1, words.end(),
        [folded](std::string_view word) { return folded.find(word) != std::string_view::npos; });
}

} // namespace

NameIndex::Item NameIndex::item(std::size_t number) const
{
    const auto part = [number](const std::string& bytes, const std::vector<std::uint32_t>& ends) {
        const auto start = number == 0 ? 0 : ends[number - 1];
        return std::string_view(bytes).substr(start, ends[number] - start);
    };
    return {part(_names, _nameEnds), part(_folded, _foldedEnds).substr(1),
        static_cast<FolderEntryKind>(_marks[number] & ~promiseMark), (_marks[number] & promiseMark) != 0};
}

platform::FoundItem NameIndex::found(std::size_t number) const
{
    const auto after = std::ranges::upper_bound(_folders, number, {}, &Folder::firstItem);
    // Empty folders have the same first item as the folder behind them.
    const auto& folder = *std::find_if(std::make_reverse_iterator(after), _folders.rend(),
        [number](const Folder& each) { return number < each.firstItem + each.itemCount; });
    const auto found = item(number);
    const bool isFolder = found.kind == FolderEntryKind::Folder;
    return {platform::Url::fileURL(folder.path)
                .appendingPathComponent(
                    found.name, isFolder ? platform::PathKind::Directory : platform::PathKind::Unknown),
        found.kind, found.isPromise};
}

std::size_t NameIndex::bytes() const
{
    std::size_t sum = _names.capacity() + _folded.capacity() + _marks.capacity()
        + (_nameEnds.capacity() + _foldedEnds.capacity()) * sizeof(std::uint32_t)
        + _folders.capacity() * sizeof(Folder);
    for (const auto& folder : _folders)
        sum += folder.path.capacity();
    return sum;
}

std::size_t NameIndex::itemAt(std::size_t foldedOffset, std::size_t from) const
{
    // Hits are close together or far apart, and steps that double find both quickly.
    std::size_t step = 1, low = from;
    while (low + step < _foldedEnds.size() && _foldedEnds[low + step] <= foldedOffset) {
        low += step;
        step *= 2;
    }
    const auto end = std::min(low + step + 1, _foldedEnds.size());
    const auto found = std::upper_bound(_foldedEnds.begin() + static_cast<std::ptrdiff_t>(low),
        _foldedEnds.begin() + static_cast<std::ptrdiff_t>(end), foldedOffset);
    return static_cast<std::size_t>(found - _foldedEnds.begin());
}

NameIndex::Found NameIndex::find(
    std::string_view foldedQuery, std::size_t limit, const std::function<bool()>& isCancelled) const
{
    const auto words = wordsOf(foldedQuery);
    if (words.empty())
        return {};
    Found found;
    std::array<std::vector<std::uint32_t>, 3> ranks;
    std::size_t offset = 0, number = 0;
    while (offset < _folded.size()) {
        const auto* hit = static_cast<const char*>(::memmem(
            _folded.data() + offset, _folded.size() - offset, words.front().data(), words.front().size()));
        if (!hit)
            break;
        number = itemAt(static_cast<std::size_t>(hit - _folded.data()), number);
        offset = _foldedEnds[number];
        const auto start = number == 0 ? 0 : _foldedEnds[number - 1];
        const auto folded = std::string_view(_folded).substr(start + 1, offset - start - 1);
        if (words.size() > 1 && !holdsAll(folded, words))
            continue;
        if (++found.total % cancelEvery == 0 && isCancelled && isCancelled())
            return {};
        if (ranks[0].size() >= limit)
            continue;
        if (auto& rank = ranks[rankOf(folded, foldedQuery)]; rank.size() < limit)
            rank.push_back(static_cast<std::uint32_t>(number));
    }
    for (const auto& rank : ranks)
        found.items.insert(found.items.end(), rank.begin(),
            rank.begin() + static_cast<std::ptrdiff_t>(std::min(rank.size(), limit - found.items.size())));
    return found;
}

void NameIndex::Builder::beginFolder(std::string path, std::int64_t modified)
{
    _index._folders.push_back({std::move(path), modified, static_cast<std::uint32_t>(itemCount()), 0});
}

void NameIndex::Builder::append(const Item& item)
{
    const auto room = std::numeric_limits<std::uint32_t>::max();
    if (_index._folders.empty() || _index._folded.size() + item.folded.size() + 1 > room
        || _index._names.size() + item.name.size() > room)
        return;
    _index._names += item.name;
    _index._nameEnds.push_back(static_cast<std::uint32_t>(_index._names.size()));
    _index._folded += '\0';
    _index._folded += item.folded;
    _index._foldedEnds.push_back(static_cast<std::uint32_t>(_index._folded.size()));
    _index._marks.push_back(
        static_cast<std::uint8_t>(static_cast<std::uint8_t>(item.kind) | (item.isPromise ? promiseMark : 0)));
    ++_index._folders.back().itemCount;
}

NameIndex NameIndex::Builder::finish()
{
    _index._names.shrink_to_fit();
    _index._folded.shrink_to_fit();
    _index._nameEnds.shrink_to_fit();
    _index._foldedEnds.shrink_to_fit();
    _index._marks.shrink_to_fit();
    _index._folders.shrink_to_fit();
    return std::move(_index);
}

} // namespace host::system
