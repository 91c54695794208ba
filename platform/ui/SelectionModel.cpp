#include "platform/ui/SelectionModel.h"

#include <algorithm>

namespace platform::ui {

void SelectionModel::select(RowId id)
{
    _ids.insert(id);
    _anchor = id;
}

void SelectionModel::deselect(RowId id)
{
    _ids.erase(id);
    _anchor = id;
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

void SelectionModel::selectOnly(RowId id)
{
    _ids = {id};
    _anchor = id;
}

void SelectionModel::selectAll(std::span<const RowId> order)
{
    _ids.insert(order.begin(), order.end());
}

void SelectionModel::extendTo(RowId id, std::span<const RowId> order)
{
    auto last = std::find(order.begin(), order.end(), id);
    if (last == order.end())
        return;
    auto first = _anchor ? std::find(order.begin(), order.end(), *_anchor) : order.end();
    if (first == order.end())
        return select(id);
    if (last < first)
        std::swap(first, last);
    // The start of the range stays, so that the next range begins at the same row.
    _ids.insert(first, last + 1);
}

void SelectionModel::clear()
{
    _ids.clear();
    _anchor.reset();
}

bool SelectionModel::keepOnly(std::span<const RowId> order)
{
    if (_ids.empty())
        return false;
    const auto before = _ids.size();
    std::unordered_set<RowId> kept;
    for (const auto id : order) {
        if (_ids.contains(id))
            kept.insert(id);
    }
    _ids = std::move(kept);
    return _ids.size() != before;
}

std::vector<RowId> SelectionModel::inOrder(std::span<const RowId> order) const
{
    std::vector<RowId> selected;
    std::copy_if(
        order.begin(), order.end(), std::back_inserter(selected), [this](RowId id) { return contains(id); });
    return selected;
}

} // namespace platform::ui
