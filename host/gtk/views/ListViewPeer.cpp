// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ListViewPeer.h"

#include "host/gtk/base/MenuPopover.h"
#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/RowModel.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <cmath>

namespace host::gtk {
using platform::Point;
using platform::weakly;

namespace {

/// The toolkit keeps about so many rows as widgets, whatever the screen shows. Further rows cost nothing.
constexpr std::size_t livingRows = 220;
/// So many rows are made in one frame, so that the frame stays short. The first frame also lays out the page.
constexpr std::size_t firstRows = 6, moreRows = 6;
/// The widgets take up to so many single changes at once. More changes are merged into one on either side of
/// the visible rows.
constexpr std::size_t mostSplices = 16;
constexpr double textMargin =
    10; ///< points above and below a row's texts, with half the distance between them
constexpr int layoutFrames = 2; ///< new rows have their heights after so many frames
constexpr int focusFrames = 4; ///< a row that was scrolled to has its widget after one or two frames

template <typename Observer, typename Peer>
std::shared_ptr<Observer> observing(Peer& peer)
{
    return std::shared_ptr<Observer>(peer.shared_from_this(), static_cast<Observer*>(&peer));
}

/// Answers the height of two lines of text and the margins around them, which is larger than usual with large
/// text.
double rowHeightForTexts()
{
    const double lines = kit::Font::preferred(kit::TextStyle::Body).lineHeight()
        + kit::Font::preferred(kit::TextStyle::Footnote).lineHeight();
    return std::max(kit::ListView::defaultRowHeight, std::ceil(lines + 2 * textMargin));
}

/// Clears the pressed look of a row. A menu takes the pointer, so the toolkit never sees the end of the press
/// that opened it, and the row would look pressed until the next press.
void endPress(GtkWidget* pressed)
{
    for (auto* widget = pressed; widget; widget = gtk_widget_get_parent(widget))
        gtk_widget_unset_state_flags(widget, GTK_STATE_FLAG_ACTIVE);
}

std::size_t rowCountBefore(const kit::ListView& list, const kit::ListChanges& changes)
{
    std::size_t count = list.rowCount();
    for (const auto& splice : changes.splices)
        count = count + splice.removed - splice.inserted;
    return count;
}

/// Answers whether a row that stayed shows something else.
bool showsAnew(const kit::ListChanges& changes, std::size_t row)
{
    const auto after = std::ranges::upper_bound(
        changes.changed, row, {}, [](const kit::RowRange& range) { return range.first; });
    return after != changes.changed.begin() && std::prev(after)->contains(row);
}

/// Answers few splices that leave the rows with widgets alone, or at least the visible ones, because a row
/// that is removed and inserted again has to be filled again.
std::vector<kit::ListSplice> splicesToTell(const kit::RowRange& visible, const kit::ListChanges& changes)
{
    if (changes.splices.size() <= mostSplices)
        return changes.splices;
    const auto before = std::min(visible.first, livingRows / 2);
    auto splices =
        changes.splicesExactWithin({visible.first - before, before + visible.count + livingRows / 2});
    return splices.size() <= mostSplices ? splices : changes.splicesExactWithin(visible);
}

} // namespace

ListViewPeer::ListViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ListView>& list)
    : ViewPeer(std::move(context), list)
    , _list(list)
    , _rows(RowModel::make())
{
    buildWidgets();
    connectInput();
}

ListViewPeer::~ListViewPeer()
{
    context().scheduler().cancel(&_fillKey);
    context().scheduler().cancel(&_growKey);
    context().scheduler().cancel(&_focusKey);
    context().scheduler().cancel(&_scrollKey);
    context().scheduler().cancel(&_onScroll);
    context().scheduler().cancel(&_hasStrayed);
    _onScroll.disconnect();
    // The list is emptied now, while its rows' handlers are still connected to this.
    gtk_list_view_set_model(GTK_LIST_VIEW(_listWidget), nullptr);
    gtk_list_view_set_factory(GTK_LIST_VIEW(_listWidget), nullptr);
}

void ListViewPeer::buildWidgets()
{
    auto* factory = gtk_signal_list_item_factory_new();
    connectFactory(factory);
    auto* selection = gtk_no_selection_new(G_LIST_MODEL(g_object_ref(_rows.get())));
    _listWidget = gtk_list_view_new(GTK_SELECTION_MODEL(selection), factory);
    gtk_list_view_set_single_click_activate(GTK_LIST_VIEW(_listWidget), TRUE);
    gtk_widget_add_css_class(_listWidget, "kit-list");
    _window = gtk_scrolled_window_new();
    // The list takes the keyboard focus, and its scrolled window does not.
    gtk_widget_set_focusable(_window, FALSE);
    gtk_scrolled_window_set_policy(GTK_SCROLLED_WINDOW(_window), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(_window), _listWidget);
    _spinner = gtk_spinner_new();
    gtk_widget_add_css_class(_spinner, "refresher");
    _refresher = gtk_revealer_new();
    gtk_revealer_set_child(GTK_REVEALER(_refresher), _spinner);
    gtk_widget_set_valign(_refresher, GTK_ALIGN_START);
    gtk_widget_set_halign(_refresher, GTK_ALIGN_CENTER);
    gtk_widget_set_can_target(_refresher, FALSE);
    auto* overlay = gtk_overlay_new();
    gtk_overlay_set_child(GTK_OVERLAY(overlay), _window);
    gtk_overlay_add_overlay(GTK_OVERLAY(overlay), _refresher);
    setNative(overlay);
}

void ListViewPeer::connectFactory(GtkListItemFactory* factory)
{
    connect(
        connectSignal<void(GtkListItem*)>(factory, "setup", [this](GtkListItem* item) { setUpRow(item); }));
    connect(connectSignal<void(GtkListItem*)>(factory, "bind", [this](GtkListItem* item) {
        _live.insert(item);
        fillSoon(item);
    }));
    connect(connectSignal<void(GtkListItem*)>(factory, "unbind", [this](GtkListItem* item) {
        _live.erase(item);
        _unfilled.erase(item);
    }));
}

void ListViewPeer::connectInput()
{
    connect(
        connectSignal<void(guint)>(_listWidget, "activate", [this](guint position) { activated(position); }));
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    _onScroll = connectSignal<void()>(adjustment, "value-changed", [this] { scrolled(); });
    connect(connectSignal<void()>(adjustment, "changed", [this] {
        fillLater();
        // This runs in the next frame, because the list is being laid out now.
        context().scheduler().scheduleNextFrame(&_onScroll, [this] { followFingerEvenIfAllIsSeen(); });
    }));
    connect(connectSignal<void(GtkPositionType)>(_window, "edge-overshot", [this](GtkPositionType edge) {
        const auto list = _list.lock();
        if (list && edge == GTK_POS_TOP && list->isRefreshable() && !list->isRefreshing())
            list->pulledToRefresh();
    }));
    auto* keys = gtk_event_controller_key_new();
    // These keys come before the list's own ones, because some of those mean something else here.
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_listWidget, keys);
    connect(connectSignal<gboolean(guint, guint, GdkModifierType)>(
        keys, "key-pressed", [this](guint key, guint, GdkModifierType modifiers) -> gboolean {
            return keyPressed(key, modifiers);
        }));
    auto* click = gtk_gesture_click_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(click), GDK_BUTTON_SECONDARY);
    gtk_widget_add_controller(_listWidget, GTK_EVENT_CONTROLLER(click));
    connect(connectSignal<void(int, double, double)>(
        click, "pressed", [this](int, double x, double y) { showMenuOfList(x, y); }));
    connectMarks();
    connectStrayingFinger();
    connectDragging();
}

void ListViewPeer::setUpRow(GtkListItem* item)
{
    using Request = ListRowWidget::Request;
    auto* row = ListRowWidget::make(
        item, weakly(this, [](ListViewPeer& self, GtkWidget* asked, Request request, double x, double y) {
            if (request == Request::Peek)
                self.held(asked, x, y);
            else
                self.showMenuOf(asked, x, y);
        }));
    auto* press = gtk_gesture_long_press_new();
    gtk_widget_add_controller(row, GTK_EVENT_CONTROLLER(press));
    connectForLife<void(double, double)>(
        press, "pressed", weakly(this, [row, press](ListViewPeer& self, double x, double y) {
            gtk_gesture_set_state(press, GTK_EVENT_SEQUENCE_CLAIMED);
            self.held(row, x, y);
            self.waitForPressOn();
        }));
    connectForLife<void(GdkEventSequence*)>(
        press, "end", weakly(this, [](ListViewPeer& self) { ++self._holds; }));
    auto* click = gtk_gesture_click_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(click), GDK_BUTTON_SECONDARY);
    gtk_widget_add_controller(row, GTK_EVENT_CONTROLLER(click));
    connectForLife<void(int, double, double)>(
        click, "pressed", weakly(this, [row, click](ListViewPeer& self, int, double x, double y) {
            gtk_gesture_set_state(click, GTK_EVENT_SEQUENCE_CLAIMED);
            self.showMenuOf(row, x, y);
        }));
    gtk_list_item_set_child(item, row);
}

void ListViewPeer::activated(guint position)
{
    const auto list = _list.lock();
    if (!list || _hasStrayed)
        return;
    const auto keepsSelf = shared_from_this();
    if (list->selectionMode() == kit::SelectionMode::Multiple && isShiftHeld())
        list->extendSelectionTo(position);
    else
        list->activateRow(position);
}

void ListViewPeer::scrolled()
{
    const auto list = _list.lock();
    if (!list)
        return;
    const double top = list->contentInsets().top;
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    list->userScrolled({0, gtk_adjustment_get_value(adjustment) - top});
    fillAfterScrolling();
}

void ListViewPeer::showMenuOf(GtkWidget* row, double x, double y)
{
    // A row that got the keyboard focus now would take it from the menu and so close the menu.
    context().scheduler().cancel(&_focusKey);
    const auto list = _list.lock();
    if (!list)
        return;
    // The menu belongs to the list and not to the row, whose widget may show another row while the menu is
    // open.
    double listX = x, listY = y;
    gtk_widget_translate_coordinates(row, widget(), x, y, &listX, &listY);
    endPress(row);
    showMenu(widget(), listX, listY, list->menuForRow(ListRowWidget::position(row)));
}

void ListViewPeer::showMenuOfList(double x, double y)
{
    const auto list = _list.lock();
    double listX = x, listY = y;
    gtk_widget_translate_coordinates(_listWidget, widget(), x, y, &listX, &listY);
    if (list)
        showMenu(widget(), listX, listY, list->menuForList());
}

bool ListViewPeer::grabFocus()
{
    return gtk_widget_grab_focus(_listWidget);
}

void ListViewPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto list = _list.lock();
    if (!list || !changes.contains(kit::ViewChange::Content))
        return;
    if (const double height = rowHeightForTexts(); height != list->rowHeight())
        list->setRowHeight(height);
    list->setScrollObserver(observing<kit::ScrollObserver>(*this));
    list->setListObserver(observing<kit::ListViewObserver>(*this));
    showRows(list->rowCount());
    fillAllSoon();
    refreshStateDidChange(*list);
}

void ListViewPeer::showRows(std::size_t count)
{
    const std::size_t known = g_list_model_get_n_items(_rows.get());
    if (known == count)
        return;
    // A list with enough rows is complete at once. A new list grows by a few rows in each frame.
    const auto next =
        known >= livingRows || count <= firstRows ? count : std::min(count, std::max(known, firstRows));
    const auto kept = std::min(known, next);
    RowModel::splice(_rows.get(), static_cast<guint>(kept), static_cast<guint>(known - kept),
        static_cast<guint>(next - kept));
    if (next < count)
        context().scheduler().scheduleNextFrame(&_growKey, [this] { growRows(); });
}

void ListViewPeer::growRows()
{
    const auto list = _list.lock();
    const std::size_t known = g_list_model_get_n_items(_rows.get());
    if (!list || known >= list->rowCount())
        return;
    const auto next = known >= livingRows ? list->rowCount() : std::min(list->rowCount(), known + moreRows);
    RowModel::splice(_rows.get(), static_cast<guint>(known), 0, static_cast<guint>(next - known));
    if (next < list->rowCount())
        context().scheduler().scheduleNextFrame(&_growKey, [this] { growRows(); });
}

void ListViewPeer::rowsWereReset(kit::ListView& list)
{
    const auto focusedAt = focusedIndex();
    RowModel::reset(_rows.get(), 0);
    showRows(list.rowCount());
    fillAllSoon();
    if (focusedAt && list.rowCount() > 0)
        focusSoon(std::min<std::size_t>(*focusedAt, list.rowCount() - 1), focusFrames);
}

void ListViewPeer::rowsDidChange(kit::ListView& list, const kit::ListChanges& changes)
{
    const auto focusedAt = focusedIndex();
    // A list that still grows has only its beginning in the widgets, so those rows are filled again instead.
    if (g_list_model_get_n_items(_rows.get()) == rowCountBefore(list, changes))
        splice(list, changes);
    else
        fillAllSoon();
    showRows(list.rowCount());
    // The row that had the keyboard focus is gone, so the row in its place gets it.
    if (focusedAt && !focusedRow() && list.rowCount() > 0)
        focusSoon(std::min<std::size_t>(*focusedAt, list.rowCount() - 1), focusFrames);
}

void ListViewPeer::splice(const kit::ListView& list, const kit::ListChanges& changes)
{
    _isSplicing = true;
    for (const auto& splice : splicesToTell(list.visibleRows(), changes)) {
        const auto leaving = rowObjects({splice.position, splice.removed});
        RowModel::splice(_rows.get(), static_cast<guint>(splice.position), static_cast<guint>(splice.removed),
            static_cast<guint>(splice.inserted), leaving);
    }
    _isSplicing = false;
    for (auto* item : _live) {
        if (showsAnew(changes, gtk_list_item_get_position(item)))
            _unfilled.insert(item);
    }
    if (!_unfilled.empty())
        fillLater();
}

/// Answers the objects of the rows in a range that have widgets.
std::vector<ObjectRef<GObject>> ListViewPeer::rowObjects(const kit::RowRange& range) const
{
    std::vector<ObjectRef<GObject>> objects;
    for (auto* item : _live) {
        if (range.contains(gtk_list_item_get_position(item)))
            objects.push_back(ObjectRef<GObject>::retain(G_OBJECT(gtk_list_item_get_item(item))));
    }
    return objects;
}

void ListViewPeer::rowDidChange(kit::ListView&, std::size_t index)
{
    for (auto* item : _live) {
        if (gtk_list_item_get_position(item) == index)
            _unfilled.insert(item);
    }
    fillLater();
}

void ListViewPeer::selectionDidChange(kit::ListView&)
{
    fillAllSoon();
}

void ListViewPeer::scrollTo(kit::ScrollView& view, Point offset, bool /*animated*/)
{
    moveTo(offset.y + view.contentInsets().top, layoutFrames);
}

void ListViewPeer::moveTo(double value, int frames)
{
    const auto list = _list.lock();
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    const double end = value + gtk_adjustment_get_page_size(adjustment);
    const bool isKnown = end <= gtk_adjustment_get_upper(adjustment);
    if (!list || value <= 0 || isKnown || frames == 0) {
        const SignalBlock block(_onScroll);
        gtk_adjustment_set_value(adjustment, value);
        fillLater();
        return;
    }
    // The widgets have no height and no place for rows that they have not laid out yet, so the move takes a
    // second step.
    RowModel::complete(_rows.get(), static_cast<guint>(list->rowCount()));
    context().scheduler().scheduleNextFrame(
        &_scrollKey, [this, value, frames] { moveTo(value, frames - 1); });
}

void ListViewPeer::scrollExtentDidChange(kit::ScrollView&) { }

void ListViewPeer::scrollToRow(
    kit::ListView& list, std::size_t index, kit::RowPosition position, bool /*animated*/)
{
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    const double page = gtk_adjustment_get_page_size(adjustment), height = list.rowHeight();
    const double top = static_cast<double>(index) * height, now = gtk_adjustment_get_value(adjustment);
    double wanted = std::clamp(now, top + height - page, top);
    if (position == kit::RowPosition::Top)
        wanted = top;
    else if (position == kit::RowPosition::Middle)
        wanted = top - (page - height) / 2;
    moveTo(std::max(0.0, wanted), layoutFrames);
}

void ListViewPeer::focusRow(kit::ListView&, std::size_t index)
{
    focusSoon(index, focusFrames);
}

void ListViewPeer::focusSoon(std::size_t index, int frames)
{
    for (auto* item : _live) {
        auto* place = gtk_widget_get_parent(gtk_list_item_get_child(item));
        if (gtk_list_item_get_position(item) == index && place && gtk_widget_get_mapped(place)) {
            gtk_widget_grab_focus(place);
            return;
        }
    }
    if (frames > 0)
        context().scheduler().scheduleNextFrame(
            &_focusKey, [this, index, frames] { focusSoon(index, frames - 1); });
}

void ListViewPeer::refreshStateDidChange(kit::ListView& list)
{
    gtk_spinner_set_spinning(GTK_SPINNER(_spinner), list.isRefreshing());
    gtk_revealer_set_reveal_child(GTK_REVEALER(_refresher), list.isRefreshing());
}

} // namespace host::gtk
