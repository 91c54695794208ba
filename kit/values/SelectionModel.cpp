// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/SelectionModel.h"

#include <algorithm>

namespace kit {

void SelectionModel::touch(RowId id)
{
    _anchor = id;
    _range.reset();
}

void SelectionModel::select(RowId id)
{
    _ids.insert(id);
    touch(id);
}

void SelectionModel::deselect(RowId id)
{
    _ids.erase(id);
    touch(id);
}

bool SelectionModel::toggle(RowId id)
{
    const bool wasSelected = contains(id);
    if (wasSelected)
        deselect(id);
    else
        select(id);
    return !wasSelected;
}

void SelectionModel::selectAll(std::span<const RowId> order)
{
    _ids.insert(order);
    _range.reset();
}

void SelectionModel::extendTo(RowId id, std::span<const RowId> order)
{
    auto last = std::ranges::find(order, id);
    if (last == order.end())
        return;
    auto first = _anchor ? std::ranges::find(order, *_anchor) : order.end();
    if (first == order.end())
        return select(id);
    if (last < first)
        std::swap(first, last);
    if (!_range)
        _range = Range{_ids, contains(*_anchor)};
    _ids = _range->before;
    const std::span<const RowId> range(first, last + 1);
    if (_range->selects)
        _ids.insert(range);
    else
        std::ranges::for_each(range, [this](RowId row) { _ids.erase(row); });
}

void SelectionModel::clear()
{
    _ids.clear();
    _anchor.reset();
    _range.reset();
}

bool SelectionModel::keepOnly(std::span<const RowId> order)
{
    if (_ids.empty())
        return false;
    const auto before = _ids.size();
    RowIdSet kept;
    for (const auto id : order) {
        if (_ids.contains(id))
            kept.insert(id);
    }
    _ids = std::move(kept);
    // The range's earlier selection may hold rows that are gone, so the next range starts anew.
    _range.reset();
    return _ids.size() != before;
}

std::vector<RowId> SelectionModel::inOrder(std::span<const RowId> order) const
{
    std::vector<RowId> selected;
    std::ranges::copy_if(order, std::back_inserter(selected), [this](RowId id) { return contains(id); });
    return selected;
}

} // namespace kit
