#include "host/gtk/ListViewPeer.h"

#include "host/gtk/FirstList.h"
#include "host/gtk/ListRowWidget.h"
#include "host/gtk/MenuPopover.h"
#include "host/gtk/RowModel.h"

#include <algorithm>

namespace host::gtk {

namespace ui = platform::ui;
using platform::Point;

namespace {

/// The toolkit keeps about this many rows as widgets, whatever the screen shows; more rows cost nothing.
constexpr std::size_t livingRows = 220;
/// How many of them are made in one frame, so that a frame stays a frame: the first fill a tall screen.
constexpr std::size_t firstRows = 24, moreRows = 12;

template <typename Observer, typename Peer>
std::shared_ptr<Observer> observing(Peer& peer)
{
    return std::shared_ptr<Observer>(peer.shared_from_this(), static_cast<Observer*>(&peer));
}

bool isShiftHeld(GtkWidget* widget)
{
    auto* seat = gdk_display_get_default_seat(gtk_widget_get_display(widget));
    auto* keyboard = seat ? gdk_seat_get_keyboard(seat) : nullptr;
    return keyboard && (gdk_device_get_modifier_state(keyboard) & GDK_SHIFT_MASK) != 0;
}

std::size_t rowCountBefore(const ui::ListView& list, const ui::ListChanges& changes)
{
    std::size_t count = list.rowCount();
    for (const auto& splice : changes.splices)
        count = count + splice.removed - splice.inserted;
    return count;
}

} // namespace

ListViewPeer::ListViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<ui::ListView>& list)
    : ViewPeer(std::move(context), list)
    , _list(list)
    , _rows(RowModel::make())
{
    buildWidgets();
    connectInput();
}

ListViewPeer::~ListViewPeer()
{
    context().scheduler().cancel(&_refreshKey);
    context().scheduler().cancel(&_growKey);
    _onScroll.disconnect();
    // The list ends now, while its rows' handlers are still connected to this.
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
        bindRow(item);
    }));
    connect(connectSignal<void(GtkListItem*)>(
        factory, "unbind", [this](GtkListItem* item) { _live.erase(item); }));
}

void ListViewPeer::connectInput()
{
    connect(
        connectSignal<void(guint)>(_listWidget, "activate", [this](guint position) { activated(position); }));
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    _onScroll = connectSignal<void()>(adjustment, "value-changed", [this] { scrolled(); });
    connect(connectSignal<void(GtkPositionType)>(_window, "edge-overshot", [this](GtkPositionType edge) {
        const auto list = _list.lock();
        if (list && edge == GTK_POS_TOP && list->isRefreshable() && !list->isRefreshing())
            list->pulledToRefresh();
    }));
    auto* keys = gtk_event_controller_key_new();
    gtk_widget_add_controller(_listWidget, keys);
    connect(connectSignal<gboolean(guint, guint, GdkModifierType)>(
        keys, "key-pressed", [this](guint key, guint, GdkModifierType modifiers) -> gboolean {
            return keyPressed(key, modifiers);
        }));
}

void ListViewPeer::setUpRow(GtkListItem* item)
{
    auto* row = ListRowWidget::make(item);
    auto* press = gtk_gesture_long_press_new();
    gtk_widget_add_controller(row, GTK_EVENT_CONTROLLER(press));
    const auto weak = std::static_pointer_cast<ListViewPeer>(shared_from_this());
    const std::weak_ptr<ListViewPeer> peer = weak;
    const auto menu = [peer, row](GtkGesture* gesture, double x, double y) {
        const auto self = peer.lock();
        if (!self)
            return;
        gtk_gesture_set_state(gesture, GTK_EVENT_SEQUENCE_CLAIMED);
        self->showMenuOf(row, x, y);
    };
    connectForLife<void(double, double)>(
        press, "pressed", [menu, press](double x, double y) { menu(press, x, y); });
    auto* click = gtk_gesture_click_new();
    gtk_gesture_single_set_button(GTK_GESTURE_SINGLE(click), GDK_BUTTON_SECONDARY);
    gtk_widget_add_controller(row, GTK_EVENT_CONTROLLER(click));
    connectForLife<void(int, double, double)>(
        click, "pressed", [menu, click](int, double x, double y) { menu(click, x, y); });
    gtk_list_item_set_child(item, row);
}

void ListViewPeer::bindRow(GtkListItem* item)
{
    const auto list = _list.lock();
    const guint position = gtk_list_item_get_position(item);
    // Between two splices of one change the widgets may ask for a place that the model has no row for.
    if (list && position < list->rowCount())
        ListRowWidget::show(gtk_list_item_get_child(item), list->row(position), list->rowHeight());
}

std::vector<GtkWidget*> ListViewPeer::liveRows() const
{
    std::vector<GtkWidget*> rows;
    for (auto* item : _live)
        rows.push_back(gtk_list_item_get_child(item));
    return rows;
}

void ListViewPeer::activated(guint position)
{
    const auto list = _list.lock();
    if (!list)
        return;
    const auto keepsSelf = shared_from_this();
    if (list->selectionMode() == ui::SelectionMode::Multiple && isShiftHeld(_listWidget))
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
}

bool ListViewPeer::keyPressed(guint key, GdkModifierType modifiers)
{
    const auto list = _list.lock();
    if (list && key == GDK_KEY_F5 && list->isRefreshable() && !list->isRefreshing()) {
        list->pulledToRefresh();
        return true;
    }
    if (key != GDK_KEY_Menu && !(key == GDK_KEY_F10 && (modifiers & GDK_SHIFT_MASK)))
        return false;
    auto* focused = gtk_root_get_focus(gtk_widget_get_root(_listWidget));
    auto* row = focused ? gtk_widget_get_first_child(focused) : nullptr;
    if (!row || !ListRowWidget::isRow(row))
        return false;
    showMenuOf(row, gtk_widget_get_width(row) / 2.0, gtk_widget_get_height(row) / 2.0);
    return true;
}

void ListViewPeer::showMenuOf(GtkWidget* row, double x, double y)
{
    const auto list = _list.lock();
    if (!list)
        return;
    // On the list rather than on the row, whose widget may be given to another row while the menu is open.
    double listX = x, listY = y;
    gtk_widget_translate_coordinates(row, widget(), x, y, &listX, &listY);
    showMenu(widget(), listX, listY, list->menuForRow(ListRowWidget::position(row)));
}

bool ListViewPeer::grabFocus()
{
    return gtk_widget_grab_focus(_listWidget);
}

void ListViewPeer::mirror(ui::View& shown, ui::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto list = _list.lock();
    if (!list || !changes.contains(ui::ViewChange::Content))
        return;
    list->setScrollObserver(observing<ui::ScrollObserver>(*this));
    list->setListObserver(observing<ui::ListViewObserver>(*this));
    showRows(list->rowCount());
    refreshRows();
    refreshStateDidChange(*list);
}

void ListViewPeer::showRows(std::size_t count)
{
    const std::size_t known = g_list_model_get_n_items(_rows.get());
    if (known == count)
        return;
    // A list that is far enough is complete at once; one that begins grows into its rows.
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

void ListViewPeer::rowsWereReset(ui::ListView& list)
{
    RowModel::reset(_rows.get(), 0);
    showRows(list.rowCount());
    refreshRowsLater();
}

void ListViewPeer::rowsDidChange(ui::ListView& list, const ui::ListChanges& changes)
{
    // A list that still grows shows its beginning only: its rows are read anew instead.
    if (g_list_model_get_n_items(_rows.get()) == rowCountBefore(list, changes)) {
        for (const auto& splice : changes.splices)
            RowModel::splice(_rows.get(), static_cast<guint>(splice.position),
                static_cast<guint>(splice.removed), static_cast<guint>(splice.inserted));
    }
    showRows(list.rowCount());
    refreshRowsLater();
}

void ListViewPeer::rowDidChange(ui::ListView&, std::size_t /*index*/)
{
    refreshRowsLater();
}

void ListViewPeer::selectionDidChange(ui::ListView&)
{
    refreshRowsLater();
}

void ListViewPeer::refreshRowsLater()
{
    context().scheduler().schedule(&_refreshKey, [this] { refreshRows(); });
}

void ListViewPeer::refreshRows()
{
    for (auto* item : _live)
        bindRow(item);
    if (!_live.empty())
        noteFirstList(_listWidget);
}

void ListViewPeer::scrollTo(ui::ScrollView& view, Point offset, bool /*animated*/)
{
    if (const auto list = _list.lock(); list && offset.y > 0)
        RowModel::complete(_rows.get(), static_cast<guint>(list->rowCount()));
    const SignalBlock block(_onScroll);
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    gtk_adjustment_set_value(adjustment, offset.y + view.contentInsets().top);
}

void ListViewPeer::scrollExtentDidChange(ui::ScrollView&) { }

void ListViewPeer::scrollToRow(
    ui::ListView& list, std::size_t index, ui::RowPosition position, bool /*animated*/)
{
    RowModel::complete(_rows.get(), static_cast<guint>(list.rowCount()));
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(_window));
    const double page = gtk_adjustment_get_page_size(adjustment), height = list.rowHeight();
    const double top = static_cast<double>(index) * height, now = gtk_adjustment_get_value(adjustment);
    double wanted = std::clamp(now, top + height - page, top);
    if (position == ui::RowPosition::Top)
        wanted = top;
    else if (position == ui::RowPosition::Middle)
        wanted = top - (page - height) / 2;
    // The widgets of new rows are not laid out yet: the range is set by the model, which knows it.
    gtk_adjustment_set_upper(adjustment,
        std::max(gtk_adjustment_get_upper(adjustment), static_cast<double>(list.rowCount()) * height));
    gtk_adjustment_set_value(adjustment, std::max(0.0, wanted));
}

void ListViewPeer::refreshStateDidChange(ui::ListView& list)
{
    gtk_spinner_set_spinning(GTK_SPINNER(_spinner), list.isRefreshing());
    gtk_revealer_set_reveal_child(GTK_REVEALER(_refresher), list.isRefreshing());
}

} // namespace host::gtk
