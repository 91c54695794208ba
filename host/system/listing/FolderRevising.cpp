// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/FolderRevising.h"

#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <numeric>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace host::system {

using platform::FileType;
using platform::FolderEntry;
using platform::FolderEntryKind;
using platform::FolderGrouping;
using platform::FolderRevision;
using platform::FolderSnapshot;

namespace {

/// The present item at a name.
struct Look {
    bool isThere = false, isPromise = false,
         isPlaced = false; ///< placed: its place in the previous list is known
    FolderEntryKind kind = FolderEntryKind::Document;
};

class Revising {
public:
    Revising(const ListingTools& tools, FolderGrouping grouping, const FolderSnapshot& before)
        : _tools(tools)
        , _grouping(grouping)
        , _before(before)
    {
    }

    void lookAt(const FileDescriptor& folder, std::span<const std::string> names);
    void findInListBefore();
    void sortNewcomers();
    std::shared_ptr<const FolderSnapshot> make(const std::shared_ptr<const FolderSnapshot>& before);
    bool isNothingNew() const { return _gone.empty() && _stayed.empty() && _newcomers.count() == 0; }

private:
    struct NameHash : std::hash<std::string_view> {
        using is_transparent = void;
    };
    using Stayed = std::pair<std::uint32_t, Look>;

    void lookAtItem(const FileDescriptor& folder, std::string_view name);
    Look look(const FileDescriptor& folder, const std::string& name) const;
    void place(std::uint32_t index, const FolderEntry& entry, Look& look);
    bool isBefore(std::size_t index, std::size_t newcomer) const;
    std::size_t placeOf(std::size_t newcomer, std::size_t from) const;
    void takeOver(FolderSnapshot::Builder& builder, std::size_t from, std::size_t to);

    const ListingTools& _tools;
    const FolderGrouping _grouping;
    const FolderSnapshot& _before;
    std::unordered_map<std::string, Look, NameHash, std::equal_to<>> _looks;
    std::vector<std::uint32_t> _gone; ///< indexes in the previous list
    std::vector<Stayed> _stayed; ///< indexes in the previous list, and the present items
    ListingBlock _newcomers;
    std::vector<std::size_t>
        _places; ///< for each newcomer the index in the previous list before which it belongs
    mutable std::vector<std::uint8_t> _key; ///< key of the entry that is being compared
    FolderRevision _revision;
    std::size_t _nextGone = 0, _nextStayed = 0;
};

/// Looks at the item for which a reported name stands.
void Revising::lookAt(const FileDescriptor& folder, std::span<const std::string> names)
{
    std::unordered_set<std::string> longPromises;
    LongNameReading longName;
    for (const auto& name : names) {
        if (isLongPromiseName(name))
            longPromises.insert(name);
        // A promise's file has a hidden name, which stands for the promised item.
        const auto listed = _tools.classifier.classify(folder, name, FileType::Regular, longName);
        if (listed)
            lookAtItem(folder, listed->name);
    }
    // The promise of a long name that is gone says its name no more, so the list is searched for it.
    for (std::size_t index = 0; !longPromises.empty() && index < _before.count(); ++index) {
        const auto name = _before.entry(index).name;
        if (name.size() > longestNameInPromise && longPromises.contains(promisePath(name)))
            lookAtItem(folder, name);
    }
}

void Revising::lookAtItem(const FileDescriptor& folder, std::string_view name)
{
    const auto [found, isNew] = _looks.try_emplace(std::string(name));
    if (isNew)
        found->second = look(folder, found->first);
}

Look Revising::look(const FileDescriptor& folder, const std::string& name) const
{
    Look found;
    const auto type = typeOfEntry(folder, name);
    const auto promise = promisePath(name);
    LongNameReading longName;
    std::optional<FolderEntry> entry;
    if (!type.error.is(ENOENT)) // what cannot be looked at is there
        entry = _tools.classifier.classify(name, type.value.value_or(FileType::Other));
    else if (const auto promiseType = typeOfEntry(folder, promise); !promiseType.error.is(ENOENT))
        entry = _tools.classifier.classify(
            folder, promise, promiseType.value.value_or(FileType::Regular), longName);
    if (longName.mayBeThere())
        entry = _tools.classifier.promised(name);
    if (entry)
        found = {true, entry->isPromise, false, entry->kind};
    return found;
}

void Revising::findInListBefore()
{
    // The lengths of the names are compared first, because most names of a long list differ in length from
    // the few that are sought.
    std::array<bool, 256> lengths{};
    const auto lengthMark = [](std::string_view name) { return std::min<std::size_t>(name.size(), 255); };
    for (const auto& [name, look] : _looks)
        lengths[lengthMark(name)] = true;
    for (std::size_t index = 0; index < _before.count(); ++index) {
        const auto entry = _before.entry(index);
        if (!lengths[lengthMark(entry.name)] || _before.extraItem(index))
            continue;
        if (const auto found = _looks.find(entry.name); found != _looks.end())
            place(static_cast<std::uint32_t>(index), entry, found->second);
    }
}

void Revising::place(std::uint32_t index, const FolderEntry& entry, Look& look)
{
    const bool keepsGroup =
        _grouping == FolderGrouping::Mixed || opensAsFolder(entry.kind) == opensAsFolder(look.kind);
    look.isPlaced = look.isThere && keepsGroup;
    if (look.isPlaced)
        _stayed.emplace_back(index, look);
    else
        _gone.push_back(index);
}

void Revising::sortNewcomers()
{
    for (const auto& [name, look] : _looks) {
        if (look.isThere && !look.isPlaced)
            _newcomers.append({name, look.kind, look.isPromise});
    }
    _newcomers.sort(_tools.order, _grouping);
    for (std::size_t i = 0; i < _newcomers.count(); ++i)
        _places.push_back(placeOf(i, _places.empty() ? 0 : _places.back()));
}

bool Revising::isBefore(std::size_t index, std::size_t newcomer) const
{
    const auto entry = _before.entry(index);
    _key.clear();
    ListingBlock::appendKey(entry, _tools.order, _grouping, _key);
    return _newcomers.isAfter(entry, _key, newcomer);
}

/// Finds the place of a newcomer. Newcomers are often neighbours, so the search begins with small steps that
/// grow.
std::size_t Revising::placeOf(std::size_t newcomer, std::size_t from) const
{
    std::size_t step = 1, end = from;
    for (; end < _before.count() && isBefore(end, newcomer); step *= 2) {
        from = end + 1;
        end += step;
    }
    end = std::min(end, _before.count());
    while (from < end) {
        const auto half = from + (end - from) / 2;
        if (isBefore(half, newcomer))
            from = half + 1;
        else
            end = half;
    }
    return from;
}

/// Copies a range of the previous list, without the removed entries.
void Revising::takeOver(FolderSnapshot::Builder& builder, std::size_t from, std::size_t to)
{
    while (from < to) {
        const std::size_t gone = _nextGone < _gone.size() ? _gone[_nextGone] : to;
        const std::size_t stayed = _nextStayed < _stayed.size() ? _stayed[_nextStayed].first : to;
        const auto end = std::min({gone, stayed, to});
        builder.keep(_before, from, end - from);
        from = end;
        if (from == to)
            return;
        if (from == stayed) {
            const auto& look = _stayed[_nextStayed++].second;
            _revision.touched.push_back(static_cast<std::uint32_t>(builder.count()));
            builder.keep(_before, from, look.kind, look.isPromise);
        } else {
            ++_nextGone;
        }
        ++from;
    }
}

std::shared_ptr<const FolderSnapshot> Revising::make(const std::shared_ptr<const FolderSnapshot>& before)
{
    FolderSnapshot::Builder builder(_before);
    builder.reserve(_before.count() + _newcomers.count(), 0);
    std::size_t taken = 0;
    for (std::size_t i = 0; i < _newcomers.count(); ++i) {
        takeOver(builder, taken, _places[i]);
        taken = _places[i];
        _revision.inserted.push_back(static_cast<std::uint32_t>(builder.count()));
        const auto entry = _newcomers.entry(_newcomers.numberAt(i));
        builder.append(entry.name, entry.kind, entry.isPromise);
    }
    takeOver(builder, taken, _before.count());
    _revision.before = before;
    _revision.removed = std::move(_gone);
    return builder.finish(std::move(_revision));
}

} // namespace

bool mayBeListed(std::string_view name)
{
    return !name.starts_with('.') || name.ends_with(promiseSuffix) || isLongPromiseName(name);
}

std::shared_ptr<const FolderSnapshot> revisedList(const ListingTools& tools, FolderGrouping grouping,
    const FileDescriptor& folder, const std::shared_ptr<const FolderSnapshot>& before,
    std::span<const std::string> names)
{
    Revising revising(tools, grouping, *before);
    revising.lookAt(folder, names);
    revising.findInListBefore();
    revising.sortNewcomers();
    return revising.isNothingNew() ? before : revising.make(before);
}

} // namespace host::system
