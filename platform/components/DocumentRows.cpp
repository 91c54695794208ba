#include "platform/components/DocumentRows.h"

#include <algorithm>
#include <functional>
#include <string>
#include <unordered_map>

namespace platform::components {

namespace {

ui::RowId idOfName(std::string_view name)
{
    return std::hash<std::string_view>{}(name);
}

ui::RowId idOfExtraItem(const Url& url)
{
    // A library may have the name of a folder beside it.
    return ~std::hash<std::string>{}(url.path());
}

char folded(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

/// What a row shows of its entry beside the name, in one number.
unsigned appearance(const FolderEntry& entry)
{
    return static_cast<unsigned>(entry.kind) * 2 + (entry.isPromise ? 1 : 0);
}

std::unordered_map<ui::RowId, unsigned> appearances(const DocumentRows& rows)
{
    std::unordered_map<ui::RowId, unsigned> found;
    found.reserve(rows.count());
    for (std::size_t row = 0; row < rows.count(); ++row)
        found.emplace(rows.ids()[row], appearance(rows.entry(row)));
    return found;
}

std::vector<ui::RowRange> rowsOfOtherAppearance(const DocumentRows& before, const DocumentRows& after)
{
    std::vector<ui::RowRange> changed;
    const auto known = appearances(before);
    for (std::size_t row = 0; row < after.count(); ++row) {
        const auto found = known.find(after.ids()[row]);
        if (found == known.end() || found->second == appearance(after.entry(row)))
            continue;
        if (!changed.empty() && changed.back().end() == row)
            ++changed.back().count;
        else
            changed.push_back({row, 1});
    }
    return changed;
}

} // namespace

std::shared_ptr<const DocumentRows> DocumentRows::make(
    std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order)
{
    const std::shared_ptr<DocumentRows> rows(new DocumentRows(std::move(snapshot)));
    rows->_ids.reserve(rows->_snapshot->count());
    for (std::size_t i = 0; i < rows->_snapshot->count(); ++i)
        rows->append(i);
    if (!order.isListersOwn())
        rows->sort(order);
    return rows;
}

void DocumentRows::sort(const ListOrder& order)
{
    _indexes = orderedIndexes(*_snapshot, order);
    const auto ids = _ids;
    for (std::size_t row = 0; row < _indexes.size(); ++row)
        _ids[row] = ids[_indexes[row]];
}

void DocumentRows::append(std::size_t snapshotIndex)
{
    const auto* extra = _snapshot->extraItem(snapshotIndex);
    auto id = extra ? idOfExtraItem(extra->url) : idOfName(_snapshot->entry(snapshotIndex).name);
    // For a moment a document may stand beside its own promise: same name, neighbours in the order.
    if (!_ids.empty() && _ids.back() == id)
        ++id;
    _ids.push_back(id);
}

ui::RowId DocumentRows::idFor(const Url& url) const
{
    const bool isInFolder = url.deletingLastPathComponent() == _snapshot->folder();
    return isInFolder ? idOfName(url.lastPathComponent()) : idOfExtraItem(url);
}

std::optional<std::size_t> DocumentRows::rowBeginningWith(std::string_view text, std::size_t from) const
{
    const auto same = [](char a, char b) { return folded(a) == folded(b); };
    for (std::size_t step = 0; step < count(); ++step) {
        const auto row = (from + step) % count();
        const auto name = entry(row).name;
        if (name.size() >= text.size() && std::equal(text.begin(), text.end(), name.begin(), same))
            return row;
    }
    return std::nullopt;
}

ui::ListChanges DocumentRows::changes(const DocumentRows& before, const DocumentRows& after)
{
    auto changes = ui::ListChanges::between(before.ids(), after.ids());
    changes.changed = rowsOfOtherAppearance(before, after);
    return changes;
}

} // namespace platform::components
