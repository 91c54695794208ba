// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentRows.h"

#include "screens/list/NamePrefix.h"

#include <algorithm>
#include <functional>
#include <limits>
#include <string>
#include <unordered_map>
#include <utility>

namespace screens {

namespace {

kit::RowId idOfName(std::string_view name)
{
    return std::hash<std::string_view>{}(name);
}

/// Answers in one number how a row looks apart from its name.
unsigned appearance(const FolderEntry& entry)
{
    return static_cast<unsigned>(entry.kind) * 2 + (entry.isPromise ? 1 : 0);
}

std::unordered_map<kit::RowId, unsigned> appearances(const DocumentRows& rows)
{
    std::unordered_map<kit::RowId, unsigned> found;
    found.reserve(rows.count());
    for (std::size_t row = 0; row < rows.count(); ++row)
        found.emplace(rows.ids()[row], appearance(rows.entry(row)));
    return found;
}

std::vector<kit::RowRange> rangesOf(const SnapshotOrder::Indexes& rows)
{
    std::vector<kit::RowRange> ranges;
    for (const auto row : rows) {
        if (!ranges.empty() && ranges.back().end() == row)
            ++ranges.back().count;
        else
            ranges.push_back({row, 1});
    }
    return ranges;
}

std::vector<kit::RowRange> rowsOfOtherAppearance(const DocumentRows& before, const DocumentRows& after)
{
    SnapshotOrder::Indexes changed;
    const auto known = appearances(before);
    for (std::size_t row = 0; row < after.count(); ++row) {
        const auto found = known.find(after.ids()[row]);
        if (found != known.end() && found->second != appearance(after.entry(row)))
            changed.push_back(static_cast<std::uint32_t>(row));
    }
    return rangesOf(changed);
}

/// Answers the splices that remove and insert the rows.
std::vector<kit::ListSplice> splicesOf(const SnapshotOrder::Step& step)
{
    std::vector<kit::ListSplice> splices;
    auto goes = step.removed.begin();
    auto comes = step.inserted.begin();
    std::size_t before = 0, after = 0;
    constexpr auto never = std::numeric_limits<std::size_t>::max();
    while (goes != step.removed.end() || comes != step.inserted.end()) {
        const auto untilGoing = goes == step.removed.end() ? never : *goes - before;
        const auto untilComing = comes == step.inserted.end() ? never : *comes - after;
        const auto kept = std::min(untilGoing, untilComing);
        before += kept;
        after += kept;
        kit::ListSplice splice{after, 0, 0};
        for (; goes != step.removed.end() && *goes == before; ++goes, ++before)
            ++splice.removed;
        for (; comes != step.inserted.end() && *comes == after; ++comes, ++after)
            ++splice.inserted;
        splices.push_back(splice);
    }
    return splices;
}

} // namespace

DocumentRows::DocumentRows(std::shared_ptr<const FolderSnapshot> snapshot, SnapshotOrder order)
    : _snapshot(std::move(snapshot))
    , _order(std::move(order))
{
    _ids.reserve(_snapshot->count());
}

std::shared_ptr<const DocumentRows> DocumentRows::make(
    std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order)
{
    SnapshotOrder places(*snapshot, order);
    const std::shared_ptr<DocumentRows> rows(new DocumentRows(std::move(snapshot), std::move(places)));
    for (std::size_t row = 0; row < rows->_snapshot->count(); ++row) {
        auto id = rows->idAt(row);
        // A document may for a moment stand beside its own promise. Both have the same name and are
        // neighbours in the order, so the second one gets the next identifier.
        if (row > 0 && rows->_ids.back() == id)
            ++id;
        rows->_ids.push_back(id);
    }
    return rows;
}

kit::RowId DocumentRows::idAt(std::size_t row) const
{
    const auto* extra = extraItem(row);
    return extra ? idForExtraItem(extra->url) : idOfName(entry(row).name);
}

RowsStep DocumentRows::step(
    const DocumentRows& before, std::shared_ptr<const FolderSnapshot> snapshot, const ListOrder& order)
{
    const bool isRevision = snapshot->revision() && snapshot->revision()->before.lock() == before._snapshot;
    if (isRevision && before._order.order() == order) {
        if (auto step = revised(before, snapshot))
            return std::move(*step);
    }
    const auto rows = make(std::move(snapshot), order);
    return {rows, changes(before, *rows), std::nullopt};
}

std::optional<RowsStep> DocumentRows::revised(
    const DocumentRows& before, const std::shared_ptr<const FolderSnapshot>& snapshot)
{
    SnapshotOrder::Step step;
    auto order = before._order.revised(*snapshot, step);
    if (!order)
        return std::nullopt;
    const std::shared_ptr<DocumentRows> rows(new DocumentRows(snapshot, std::move(*order)));
    RowsStep made{rows, {splicesOf(step), rangesOf(step.touched)}, std::vector<kit::RowId>()};
    auto from = before._ids.begin();
    for (const auto& splice : made.changes.splices) {
        const auto kept = static_cast<std::ptrdiff_t>(splice.position - rows->_ids.size());
        rows->_ids.insert(rows->_ids.end(), from, from + kept);
        from += kept + static_cast<std::ptrdiff_t>(splice.removed);
        for (std::size_t i = 0; i < splice.inserted; ++i)
            rows->_ids.push_back(rows->idAt(rows->_ids.size()));
    }
    rows->_ids.insert(rows->_ids.end(), from, before._ids.end());
    for (const auto* touched : {&step.inserted, &step.touched}) {
        for (const auto row : *touched)
            made.touched->push_back(rows->_ids[row]);
    }
    return made;
}

kit::RowId DocumentRows::idForExtraItem(const Url& url)
{
    // The hash is inverted, because a folder beside the library may have the same name.
    return ~std::hash<std::string>{}(url.path());
}

kit::RowId DocumentRows::idFor(const Url& url) const
{
    // The texts are compared, because URLs are costly to make for a thousand items.
    const std::string_view path = url.path();
    const auto slash = path.rfind('/');
    const bool isInFolder =
        slash != std::string_view::npos && path.substr(0, slash) == _snapshot->folder().path();
    return isInFolder ? idOfName(path.substr(slash + 1)) : idForExtraItem(url);
}

std::optional<std::size_t> DocumentRows::rowBeginningWith(std::string_view text, std::size_t from) const
{
    NamePrefix prefix(text);
    for (std::size_t step = 0; step < count(); ++step) {
        const auto row = (from + step) % count();
        if (prefix.begins(entry(row).name))
            return row;
    }
    return std::nullopt;
}

kit::ListChanges DocumentRows::changes(const DocumentRows& before, const DocumentRows& after)
{
    auto changes = kit::ListChanges::between(before.ids(), after.ids());
    changes.changed = rowsOfOtherAppearance(before, after);
    return changes;
}

} // namespace screens
