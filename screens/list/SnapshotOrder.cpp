// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/SnapshotOrder.h"

#include "platform/CloudDocumentService.h"
#include "platform/FileSystem.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "screens/DisplayName.h"

#include <algorithm>
#include <limits>
#include <map>
#include <numeric>
#include <string>
#include <unordered_map>
#include <utility>

namespace screens {

namespace {

/// An unknown key sorts before every known one.
constexpr std::int64_t unknown = std::numeric_limits<std::int64_t>::min();

std::int64_t sizeOf(std::uint64_t bytes)
{
    constexpr auto most = static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
    return static_cast<std::int64_t>(std::min(bytes, most));
}

std::int64_t lookAtPromise(const Url& url, OrderKey key)
{
    constexpr AttributeKey keys[] = {AttributeKey::ContentModificationDate, AttributeKey::FileSize};
    const auto values =
        services().cloudDocumentService().promisedItems().promisedItemResourceValues(url, keys);
    if (!values)
        return unknown;
    const auto* date = values->get<Date>(AttributeKey::ContentModificationDate);
    const auto* size = values->get<std::uint64_t>(AttributeKey::FileSize);
    if (key == OrderKey::Date)
        return date ? date->nanoseconds : unknown;
    return size ? sizeOf(*size) : unknown;
}

std::int64_t lookAt(const FolderSnapshot& snapshot, std::size_t index, OrderKey key)
{
    const auto entry = snapshot.entry(index);
    const auto url = snapshot.url(index);
    if (entry.isPromise)
        return lookAtPromise(url, key);
    const auto attributes = services().fileSystem().attributesOfItem(url.path());
    if (!attributes)
        return unknown;
    if (key == OrderKey::Date)
        return attributes->modificationDate.nanoseconds;
    return opensAsFolder(entry.kind) ? unknown : sizeOf(attributes->size);
}

} // namespace

/// Numbers the kinds in a snapshot in the order of their descriptions.
class KindRanks {
public:
    explicit KindRanks(const FolderSnapshot& snapshot)
    {
        for (std::size_t i = 0; i < snapshot.count(); ++i) {
            const auto entry = snapshot.entry(i);
            const auto known = _names.find(keyFor(entry));
            if (known == _names.end())
                _ranks.try_emplace(_names.emplace(keyFor(entry), nameOf(entry)).first->second);
        }
        std::int64_t rank = 0;
        for (auto& [name, place] : _ranks)
            place = rank++;
    }

    /// Answers nothing for a kind that does not occur in the snapshot.
    std::optional<std::int64_t> rank(const FolderEntry& entry) const
    {
        const auto known = _names.find(keyFor(entry));
        const auto found = _ranks.find(known == _names.end() ? nameOf(entry) : known->second);
        return found == _ranks.end() ? std::nullopt : std::optional(found->second);
    }

private:
    // Kinds without a name of their own come first: folders, then links.
    static std::string keyFor(const FolderEntry& entry)
    {
        if (opensAsFolder(entry.kind))
            return "\x01";
        return entry.kind == FolderEntryKind::Link ? "\x02" : std::string(nameExtension(entry.name));
    }
    static std::string nameOf(const FolderEntry& entry)
    {
        auto key = keyFor(entry);
        if (opensAsFolder(entry.kind) || entry.kind == FolderEntryKind::Link)
            return key;
        const auto& types = services().typeRegistry();
        const auto type = types.typeForExtension(key);
        return (type ? types.description(*type) : std::nullopt).value_or(key);
    }

    std::unordered_map<std::string, std::string> _names; ///< by the keys
    std::map<std::string, std::int64_t> _ranks;
};

SnapshotOrder::SnapshotOrder(const FolderSnapshot& snapshot, const ListOrder& order)
    : _order(order)
{
    if (order.isListersOwn())
        return;
    if (order.key == OrderKey::Kind)
        _kinds = std::make_shared<const KindRanks>(snapshot);
    if (order.key != OrderKey::Name) {
        _keys.resize(snapshot.count());
        for (std::size_t i = 0; i < _keys.size(); ++i)
            _keys[i] = keyOf(snapshot, i).value_or(unknown);
    }
    _indexes.resize(snapshot.count());
    std::iota(_indexes.begin(), _indexes.end(), 0U);
    std::ranges::sort(_indexes, [&](std::uint32_t a, std::uint32_t b) { return isBefore(snapshot, a, b); });
}

std::optional<std::int64_t> SnapshotOrder::keyOf(const FolderSnapshot& snapshot, std::size_t index) const
{
    return _kinds ? _kinds->rank(snapshot.entry(index)) : lookAt(snapshot, index, _order.key);
}

bool SnapshotOrder::isBefore(const FolderSnapshot& snapshot, std::uint32_t a, std::uint32_t b) const
{
    if (_order.grouping == FolderGrouping::FoldersFirst) {
        const bool isFirst = opensAsFolder(snapshot.kind(a));
        if (isFirst != opensAsFolder(snapshot.kind(b)))
            return isFirst;
    }
    const bool descends = _order.direction == OrderDirection::Descending;
    if (_keys.empty())
        return descends ? b < a : a < b;
    if (_keys[a] != _keys[b])
        return descends ? _keys[b] < _keys[a] : _keys[a] < _keys[b];
    return a < b;
}

/// Carries an order over to a revision. Rows that stay in sequence are kept, and the others are merged into
/// them.
class SnapshotOrder::Merge {
public:
    Merge(const SnapshotOrder& before, SnapshotOrder& after, const FolderSnapshot& snapshot, Step& step)
        : _before(before)
        , _after(after)
        , _snapshot(snapshot)
        , _revision(*snapshot.revision())
        , _step(step)
        , _marks(snapshot.count(), Mark::Still)
    {
    }

    bool findKeys();
    void merge();

private:
    enum class Mark : std::uint8_t { Still, Touched, Moved };
    static constexpr auto gone = std::numeric_limits<std::uint32_t>::max();

    void numberAnew();
    Indexes keptRows();
    Indexes newcomers() const;
    std::uint32_t nextStill(std::size_t row);

    const SnapshotOrder& _before;
    SnapshotOrder& _after;
    const FolderSnapshot& _snapshot;
    const FolderRevision& _revision;
    Step& _step;
    Indexes _newIndexes; ///< by the indexes in the snapshot before
    std::vector<Mark> _marks; ///< by the new indexes
    std::size_t _stillRow = 0;
};

void SnapshotOrder::Merge::numberAnew()
{
    _newIndexes.resize(_before._indexes.size());
    auto removed = _revision.removed.begin();
    auto inserted = _revision.inserted.begin();
    std::uint32_t next = 0;
    for (std::uint32_t old = 0; old < _newIndexes.size(); ++old) {
        for (; inserted != _revision.inserted.end() && *inserted == next; ++inserted)
            ++next;
        const bool goes = removed != _revision.removed.end() && *removed == old;
        _newIndexes[old] = goes ? gone : next++;
        removed += goes ? 1 : 0;
    }
}

/// Finds the keys of the new entries. Answers whether all of them are known.
bool SnapshotOrder::Merge::findKeys()
{
    numberAnew();
    for (const auto index : _revision.touched)
        _marks[index] = Mark::Touched;
    if (_before._order.key == OrderKey::Name)
        return true;
    auto& keys = _after._keys;
    keys.resize(_snapshot.count());
    for (std::size_t old = 0; old < _newIndexes.size(); ++old) {
        if (_newIndexes[old] != gone)
            keys[_newIndexes[old]] = _before._keys[old];
    }
    const auto find = [&](std::uint32_t index) {
        const auto key = _after.keyOf(_snapshot, index);
        if (key && _marks[index] == Mark::Touched && *key != keys[index])
            _marks[index] = Mark::Moved;
        keys[index] = key.value_or(unknown);
        return key.has_value();
    };
    return std::ranges::all_of(_revision.inserted, find) && std::ranges::all_of(_revision.touched, find);
}

/// Answers the new index of the first row at or after `row` that keeps its key.
std::uint32_t SnapshotOrder::Merge::nextStill(std::size_t row)
{
    const auto isStill = [this](std::size_t at) {
        const auto index = _newIndexes[_before._indexes[at]];
        return index != gone && _marks[index] != Mark::Moved;
    };
    for (_stillRow = std::max(_stillRow, row); _stillRow < _before._indexes.size(); ++_stillRow) {
        if (isStill(_stillRow))
            return _newIndexes[_before._indexes[_stillRow]];
    }
    return gone;
}

/// Answers the rows that stay in sequence. An item with another key stays when the key still sorts between
/// the same neighbours.
SnapshotOrder::Indexes SnapshotOrder::Merge::keptRows()
{
    Indexes kept;
    kept.reserve(_snapshot.count());
    for (std::uint32_t row = 0; row < _before._indexes.size(); ++row) {
        const auto index = _newIndexes[_before._indexes[row]];
        bool stays = index != gone;
        if (stays && _marks[index] == Mark::Moved) {
            const auto next = nextStill(row);
            stays = (kept.empty() || _after.isBefore(_snapshot, kept.back(), index))
                && (next == gone || _after.isBefore(_snapshot, index, next));
            _marks[index] = stays ? Mark::Touched : Mark::Moved;
        }
        if (stays)
            kept.push_back(index);
        else
            _step.removed.push_back(row);
    }
    return kept;
}

SnapshotOrder::Indexes SnapshotOrder::Merge::newcomers() const
{
    auto come = _revision.inserted;
    std::ranges::copy_if(_revision.touched, std::back_inserter(come),
        [this](std::uint32_t index) { return _marks[index] == Mark::Moved; });
    std::ranges::sort(
        come, [this](std::uint32_t a, std::uint32_t b) { return _after.isBefore(_snapshot, a, b); });
    return come;
}

void SnapshotOrder::Merge::merge()
{
    const auto kept = keptRows();
    const auto come = newcomers();
    auto& rows = _after._indexes;
    rows.reserve(kept.size() + come.size());
    auto next = come.begin();
    const auto insertUpTo = [&](std::uint32_t index) {
        for (; next != come.end() && (index == gone || _after.isBefore(_snapshot, *next, index)); ++next) {
            _step.inserted.push_back(static_cast<std::uint32_t>(rows.size()));
            rows.push_back(*next);
        }
    };
    for (const auto index : kept) {
        insertUpTo(index);
        if (_marks[index] == Mark::Touched)
            _step.touched.push_back(static_cast<std::uint32_t>(rows.size()));
        rows.push_back(index);
    }
    insertUpTo(gone);
}

std::optional<SnapshotOrder> SnapshotOrder::revised(const FolderSnapshot& after, Step& step) const
{
    SnapshotOrder made;
    made._order = _order;
    made._kinds = _kinds;
    if (_order.isListersOwn()) {
        const auto& revision = *after.revision();
        step = {revision.removed, revision.inserted, revision.touched};
        return made;
    }
    Merge merge(*this, made, after, step);
    if (!merge.findKeys())
        return std::nullopt;
    merge.merge();
    return made;
}

} // namespace screens
