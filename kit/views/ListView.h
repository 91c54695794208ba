// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/SelectionModel.h"
#include "kit/views/ListViewDataSource.h"
#include "kit/views/ListViewDelegate.h"
#include "kit/views/ListViewObserver.h"
#include "kit/views/ScrollView.h"

namespace kit {

enum class SelectionMode { None, Multiple };

/// A column of rows of one height. The rows are values of the data source. Only visible rows cost anything,
/// however many there are.
class ListView : public ScrollView {
public:
    using ScrollView::ScrollView;

    static constexpr double defaultRowHeight = 64; ///< points
    static constexpr double minimumRowHeight = 48; ///< points; smaller is no target for a finger

    void accept(ViewVisitor& visitor) override;
    void setListObserver(std::weak_ptr<ListViewObserver> observer) { _listObserver.set(std::move(observer)); }
    void setDataSource(std::weak_ptr<ListViewDataSource> dataSource);
    void setListDelegate(std::weak_ptr<ListViewDelegate> delegate) { _listDelegate = std::move(delegate); }

    double rowHeight() const { return _rowHeight; }
    void setRowHeight(double points);
    /// Answers the number of rows as of the last reload or change.
    std::size_t rowCount() const { return _rowCount; }
    ListRow row(std::size_t index) const; ///< with the check mark that the selection gives it
    RowRange visibleRows() const { return _visibleRows; }

    // The data source changes first; then these bring the list up to date.
    void reloadAll();
    void apply(const ListChanges& changes);
    void rowChanged(std::size_t index);
    void scrollToRow(std::size_t index, RowPosition position, bool animated);
    void focusRow(std::size_t index); ///< scrolls there if need be; the row takes the keyboard

    SelectionMode selectionMode() const { return _selectionMode; }
    void setSelectionMode(SelectionMode mode); ///< leaving selection mode clears the selection
    const SelectionModel& selection() const { return _selection; }
    void setSelection(SelectionModel selection); ///< by the program: the delegate is not told
    void selectAll();
    std::vector<RowId> rowIds() const; ///< of all items, in order

    bool isRefreshable() const { return _refreshable; }
    void setRefreshable(bool refreshable);
    bool isRefreshing() const { return _refreshing; }
    void endRefreshing();

    // Events up. An index past the end is ignored, because an event may arrive after the rows are gone.
    void activateRow(std::size_t index); ///< opens the row, or toggles it in selection mode
    /// Extends the selection from the row touched last. Out of selection mode the delegate is first asked to
    /// enter it.
    void extendSelectionTo(std::size_t index);
    void selectAllByUser();
    Menu menuForRow(std::size_t index);
    Menu menuForList();
    bool commandRow(std::size_t index, RowCommand command);
    std::vector<platform::Url> filesToDrag(std::size_t index);
    bool holdRow(std::size_t index);
    void pressOnHeldRow(); ///< the finger that held the row pressed on, to open it
    /// Answers the row that the typed text leads to, see ListViewDataSource::rowBeginningWith().
    std::optional<std::size_t> rowBeginningWith(std::string_view text, std::size_t from) const;
    void pulledToRefresh();

    bool becomeFirstResponder() override; ///< the row that had the keyboard last has it then, else the first
    void layoutSubviews() override;

protected:
    void contentOffsetDidChange() override;

private:
    enum class Tell { IfMoved, Always };
    void updateVisibleRows(Tell tell);
    void rowCountDidChange();
    bool isItem(std::size_t index) const;
    void selectionChangedByUser();
    bool enterSelectionMode();

    std::weak_ptr<ListViewDataSource> _dataSource;
    std::weak_ptr<ListViewDelegate> _listDelegate;
    ObserverSlot<ListViewObserver> _listObserver;
    SelectionModel _selection;
    RowRange _visibleRows;
    std::size_t _rowCount = 0;
    double _rowHeight = defaultRowHeight;
    SelectionMode _selectionMode = SelectionMode::None;
    bool _refreshable = false, _refreshing = false;
};

} // namespace kit
