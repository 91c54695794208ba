// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/ListView.h"

#include "kit/views/ViewVisitor.h"

#include <algorithm>
#include <cmath>

namespace kit {

void ListViewDelegate::refreshRequested(ListView& list)
{
    list.endRefreshing();
}

void ListView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void ListView::setDataSource(std::weak_ptr<ListViewDataSource> dataSource)
{
    _dataSource = std::move(dataSource);
    reloadAll();
}

void ListView::setRowHeight(double points)
{
    _rowHeight = std::max(points, minimumRowHeight);
    rowCountDidChange();
    updateVisibleRows(Tell::IfMoved);
    changed(ViewChange::Content);
}

ListRow ListView::row(std::size_t index) const
{
    const auto source = _dataSource.lock();
    if (!source || index >= source->numberOfRows(*this))
        return {};
    ListRow row = source->rowAtIndex(*this, index);
    if (_selectionMode == SelectionMode::Multiple && row.kind == RowKind::Item)
        row.check = _selection.contains(row.id) ? CheckState::On : CheckState::Off;
    return row;
}

void ListView::rowCountDidChange()
{
    const auto source = _dataSource.lock();
    _rowCount = source ? source->numberOfRows(*this) : 0;
    setContentSize({bounds().width, static_cast<double>(_rowCount) * _rowHeight});
}

void ListView::reloadAll()
{
    rowCountDidChange();
    _selection.keepOnly(rowIds());
    _listObserver.notify([this](ListViewObserver& observer) { observer.rowsWereReset(*this); });
    updateVisibleRows(Tell::Always);
}

void ListView::apply(const ListChanges& changes)
{
    if (changes.isEmpty())
        return;
    rowCountDidChange();
    const bool mayHaveLost =
        std::ranges::any_of(changes.splices, [](const ListSplice& splice) { return splice.removed > 0; });
    if (mayHaveLost && !_selection.isEmpty())
        _selection.keepOnly(rowIds());
    _listObserver.notify([&](ListViewObserver& observer) { observer.rowsDidChange(*this, changes); });
    updateVisibleRows(Tell::Always);
}

void ListView::rowChanged(std::size_t index)
{
    if (index < _rowCount)
        _listObserver.notify([&](ListViewObserver& observer) { observer.rowDidChange(*this, index); });
}

void ListView::scrollToRow(std::size_t index, RowPosition position, bool animated)
{
    if (index >= _rowCount)
        return;
    const double top = static_cast<double>(index) * _rowHeight;
    const double room = bounds().height - contentInsets().top - contentInsets().bottom;
    const Rect row{0, top, bounds().width, _rowHeight};
    if (position == RowPosition::Nearest)
        scrollRectToVisible(row, animated);
    else {
        const double above = position == RowPosition::Middle ? (room - _rowHeight) / 2 : 0;
        const double lowest = std::max(0.0, contentSize().height - room);
        setContentOffset({0, std::clamp(top - above, 0.0, lowest) - contentInsets().top}, animated);
    }
    _listObserver.notify(
        [&](ListViewObserver& observer) { observer.scrollToRow(*this, index, position, animated); });
}

void ListView::focusRow(std::size_t index)
{
    if (!isItem(index))
        return;
    scrollToRow(index, RowPosition::Nearest, false);
    _listObserver.notify([&](ListViewObserver& observer) { observer.focusRow(*this, index); });
}

void ListView::setSelectionMode(SelectionMode mode)
{
    if (mode == _selectionMode)
        return;
    _selectionMode = mode;
    _selection.clear();
    _listObserver.notify([this](ListViewObserver& observer) { observer.selectionDidChange(*this); });
}

void ListView::setSelection(SelectionModel selection)
{
    _selection = std::move(selection);
    _selection.keepOnly(rowIds());
    _listObserver.notify([this](ListViewObserver& observer) { observer.selectionDidChange(*this); });
}

void ListView::selectAll()
{
    SelectionModel all;
    const auto ids = rowIds();
    all.selectAll(ids);
    setSelection(std::move(all));
}

std::vector<RowId> ListView::rowIds() const
{
    std::vector<RowId> ids;
    const auto source = _dataSource.lock();
    if (!source)
        return ids;
    ids.reserve(_rowCount);
    for (std::size_t index = 0; index < _rowCount; ++index) {
        if (source->rowKindAtIndex(*this, index) == RowKind::Item)
            ids.push_back(source->rowIdAtIndex(*this, index));
    }
    return ids;
}

void ListView::setRefreshable(bool refreshable)
{
    _refreshable = refreshable;
    _listObserver.notify([this](ListViewObserver& observer) { observer.refreshStateDidChange(*this); });
}

void ListView::endRefreshing()
{
    _refreshing = false;
    _listObserver.notify([this](ListViewObserver& observer) { observer.refreshStateDidChange(*this); });
}

bool ListView::isItem(std::size_t index) const
{
    const auto source = _dataSource.lock();
    return source && index < std::min(_rowCount, source->numberOfRows(*this))
        && source->rowKindAtIndex(*this, index) == RowKind::Item;
}

void ListView::activateRow(std::size_t index)
{
    if (!isItem(index))
        return;
    if (_selectionMode == SelectionMode::Multiple) {
        _selection.toggle(_dataSource.lock()->rowIdAtIndex(*this, index));
        selectionChangedByUser();
    } else if (const auto delegate = _listDelegate.lock()) {
        delegate->rowActivated(*this, index);
    }
}

bool ListView::enterSelectionMode()
{
    if (_selectionMode == SelectionMode::Multiple)
        return true;
    if (const auto delegate = _listDelegate.lock())
        delegate->selectionRequested(*this);
    return _selectionMode == SelectionMode::Multiple;
}

void ListView::extendSelectionTo(std::size_t index)
{
    if (!isItem(index) || !enterSelectionMode())
        return;
    const auto ids = rowIds();
    _selection.extendTo(_dataSource.lock()->rowIdAtIndex(*this, index), ids);
    selectionChangedByUser();
}

void ListView::selectAllByUser()
{
    if (!enterSelectionMode())
        return;
    _selection.selectAll(rowIds());
    selectionChangedByUser();
}

void ListView::selectionChangedByUser()
{
    _listObserver.notify([this](ListViewObserver& observer) { observer.selectionDidChange(*this); });
    if (const auto delegate = _listDelegate.lock())
        delegate->selectionDidChange(*this);
}

Menu ListView::menuForRow(std::size_t index)
{
    const auto delegate = _listDelegate.lock();
    if (!delegate || !isItem(index) || _selectionMode == SelectionMode::Multiple)
        return {};
    return delegate->menuForRow(*this, index);
}

Menu ListView::menuForList()
{
    const auto delegate = _listDelegate.lock();
    return delegate ? delegate->menuForList(*this) : Menu();
}

bool ListView::commandRow(std::size_t index, RowCommand command)
{
    const auto delegate = _listDelegate.lock();
    // In selection mode only these keys have a meaning: for the selected items.
    const bool hasMeaning =
        _selectionMode == SelectionMode::None || command == RowCommand::Delete || command == RowCommand::Copy;
    return delegate && isItem(index) && hasMeaning && delegate->rowCommand(*this, index, command);
}

std::vector<platform::Url> ListView::filesToDrag(std::size_t index)
{
    const auto delegate = _listDelegate.lock();
    return delegate && isItem(index) ? delegate->filesToDrag(*this, index) : std::vector<platform::Url>();
}

bool ListView::holdRow(std::size_t index)
{
    const auto delegate = _listDelegate.lock();
    return delegate && isItem(index) && _selectionMode == SelectionMode::None
        && delegate->rowHeld(*this, index);
}

void ListView::pressOnHeldRow()
{
    if (const auto delegate = _listDelegate.lock())
        delegate->heldRowPressedOn(*this);
}

std::optional<std::size_t> ListView::rowBeginningWith(std::string_view text, std::size_t from) const
{
    const auto source = _dataSource.lock();
    return source ? source->rowBeginningWith(*this, text, from) : std::nullopt;
}

void ListView::pulledToRefresh()
{
    const auto delegate = _listDelegate.lock();
    if (!_refreshable || _refreshing || !delegate)
        return;
    _refreshing = true;
    delegate->refreshRequested(*this);
}

bool ListView::becomeFirstResponder()
{
    askForFocus(true);
    return true;
}

void ListView::layoutSubviews()
{
    setContentSize({bounds().width, static_cast<double>(_rowCount) * _rowHeight});
    updateVisibleRows(Tell::IfMoved);
}

void ListView::contentOffsetDidChange()
{
    updateVisibleRows(Tell::IfMoved);
}

void ListView::updateVisibleRows(Tell tell)
{
    const auto count = static_cast<double>(_rowCount);
    const double top = std::clamp(std::floor(contentOffset().y / _rowHeight), 0.0, count);
    const double bottom =
        std::clamp(std::ceil((contentOffset().y + bounds().height) / _rowHeight), top, count);
    const RowRange visible{static_cast<std::size_t>(top), static_cast<std::size_t>(bottom - top)};
    if (visible == _visibleRows && tell == Tell::IfMoved)
        return;
    _visibleRows = visible;
    if (const auto delegate = _listDelegate.lock())
        delegate->visibleRowsDidChange(*this, visible);
}

} // namespace kit
