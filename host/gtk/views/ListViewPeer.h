// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"
#include "kit/values/TypeAhead.h"
#include "kit/views/ListView.h"

#include <optional>
#include <unordered_set>

namespace host::gtk {

/// Shows a list with a GtkListView over a lazy model. Only rows near the visible ones have widgets. Of many
/// changes at once the toolkit is told only those near the visible rows one by one
/// (ListChanges::splicesExactWithin). A place among rows that were never laid out is reached once they have
/// heights.
///
/// Keys (ListViewPeer+Keyboard.cpp): F2, Delete and Alt+Return act on a row, Space peeks at it, Menu and
/// Shift+F10 open its menu, Ctrl+A and Shift with the arrows select, letters type ahead, Tab leaves the list.
/// Touches (ListViewPeer+Touch.cpp): a drag along the check marks selects a range. A finger that is held on a
/// row shows its preview, and opens it when it stays. A finger that leaves its place opens nothing, and a
/// list whose rows are all visible can be pulled.
class ListViewPeer : public ViewPeer, public kit::ScrollObserver, public kit::ListViewObserver {
public:
    ListViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ListView>& list);
    ~ListViewPeer() override;

    void scrollTo(kit::ScrollView& view, platform::Point offset, bool animated) override;
    void scrollExtentDidChange(kit::ScrollView& view) override;
    void rowsWereReset(kit::ListView& list) override;
    void rowsDidChange(kit::ListView& list, const kit::ListChanges& changes) override;
    void rowDidChange(kit::ListView& list, std::size_t index) override;
    void selectionDidChange(kit::ListView& list) override;
    void scrollToRow(
        kit::ListView& list, std::size_t index, kit::RowPosition position, bool animated) override;
    void focusRow(kit::ListView& list, std::size_t index) override;
    void refreshStateDidChange(kit::ListView& list) override;

    bool grabFocus() override;
    GtkWidget* listWidget() const { return _listWidget; }
    /// Answers the widgets of the rows that exist now, in no order.
    std::vector<GtkWidget*> liveRows() const;

protected:
    GtkWidget* spoken() const override { return _listWidget; }
    GtkWidget* childContainer() const override { return widget(); }
    platform::Point childOrigin() const override { return {}; }
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    void buildWidgets();
    void connectFactory(GtkListItemFactory* factory);
    void connectInput();
    void connectMarks();
    void connectStrayingFinger();
    void connectDragging();
    GdkContentProvider* beginDrag(GtkDragSource* source, double x, double y) const;
    void followFinger(GdkEvent* event);
    void setUpRow(GtkListItem* item);
    void bindRow(GtkListItem* item);
    void activated(guint position);
    void scrolled();
    void followFingerEvenIfAllIsSeen();
    /// Tells the widgets of as many rows as can be made in a frame, and of more in the next frames.
    void showRows(std::size_t count);
    void growRows();
    std::vector<ObjectRef<GObject>> rowObjects(const kit::RowRange& range) const;
    void splice(const kit::ListView& list, const kit::ListChanges& changes);
    /// Scrolls to a height, at the latest after so many frames.
    void moveTo(double value, int frames);
    /// Visible rows are filled at once, and those beside them a few in each frame.
    void fillSoon(GtkListItem* item);
    void fillAllSoon();
    void fillLater();
    void fillRows();
    void fillSeenRows();
    void fillAfterScrolling();
    void noteMisfits();
    std::vector<GtkListItem*> unfilledBesideSeen() const;
    void showMenuOf(GtkWidget* row, double x, double y);
    void showMenuOfList(double x, double y);
    void held(GtkWidget* row, double x, double y);
    void waitForPressOn();

    // These handle the keyboard.
    bool keyPressed(guint key, GdkModifierType modifiers);
    bool leaveByTab(GtkDirectionType direction);
    /// The list forgets the row that has its focus when all rows are replaced, and lets nobody in then.
    bool canvasTakesFocus() override;
    bool rowKeyPressed(std::size_t row, guint key, GdkModifierType modifiers);
    bool listKeyPressed(guint key, GdkModifierType modifiers);
    bool extendByKey(std::size_t from, guint key);
    bool typedAhead(guint key, GdkModifierType modifiers);
    bool isShiftHeld() const;
    GtkWidget* focusedRow() const;
    std::optional<std::size_t> focusedIndex() const;
    GtkWidget* rowAt(double x, double y) const;
    /// Gives the keyboard focus to a row as soon as it has a widget.
    void focusSoon(std::size_t index, int frames);

    std::weak_ptr<kit::ListView> _list;
    ObjectRef<GListModel> _rows;
    GtkWidget *_listWidget = nullptr, *_window = nullptr, *_refresher = nullptr, *_spinner = nullptr;
    std::unordered_set<GtkListItem*> _live;
    std::unordered_set<GtkListItem*> _unfilled; ///< the live rows that do not show their content yet
    bool _isSplicing = false; ///< rows are not at their final places
    SignalConnection _onScroll;
    kit::TypeAhead _typeAhead;
    platform::Point _fingerStart; ///< the place where the first finger touched
    int _fingers = 0; ///< the number of fingers on the list
    bool _hasStrayed = false; ///< the present touch opens no row
    int _holds = 0; ///< counts the fingers that held a row, so that an earlier one does not press on
    int _focusKey = 0; ///< its address names the focusing of a row in the scheduler
    int _scrollKey = 0; ///< its address names the second step of a scrolling in the scheduler
    int _growKey = 0; ///< its address names the growing of the list in the scheduler
    int _fillKey = 0; ///< its address names the filling of rows in the scheduler
};

} // namespace host::gtk
