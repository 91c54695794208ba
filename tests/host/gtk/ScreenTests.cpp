// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/views/ListRowWidget.h"
#include "host/gtk/views/ListViewPeer.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"

#include <X11/Xatom.h>
#include <gdk/x11/gdkx.h>

#include <algorithm>
#include <map>
#include <numeric>

namespace {
using testing_support::makeScreen;

class NavigationTests : public testing_support::WindowFixture {
protected:
    host::gtk::NavigationPeer& navigationPeer() const
    {
        return dynamic_cast<host::gtk::NavigationPeer&>(*peer().rootPeer());
    }
    GtkWidget* backButton() const { return navigationPeer().topPage()->navigationBar().backButton(); }
};

TEST_F(NavigationTests, TheShownPageIsTheTopScreen)
{
    const auto first = makeScreen("First"), second = makeScreen("Second"), third = makeScreen("Third");
    const auto stack = showStack({first});
    const auto shownTitle = [&] { return navigationPeer().topPage()->screen()->title(); };
    const auto visible = [&] { return adw_leaflet_get_visible_child(navigationPeer().leaflet()); };
    EXPECT_FALSE(gtk_widget_get_visible(backButton()));

    for (const bool animated : {false, true}) {
        g_object_set(gtk_settings_get_default(), "gtk-enable-animations", animated, nullptr);
        stack->pushViewController(second, animated);
        waitFor([&] { return !stack->isTransitioning(); }, "the push");
        settle();
        EXPECT_EQ(shownTitle(), "Second");
        EXPECT_EQ(visible(), navigationPeer().topPage()->widget());
        EXPECT_TRUE(gtk_widget_get_visible(backButton()));
        EXPECT_EQ(second->appearanceState(), kit::AppearanceState::Appeared);

        g_signal_emit_by_name(backButton(), "clicked");
        waitFor([&] { return !stack->isTransitioning(); }, "the pop");
        settle();
        EXPECT_EQ(stack->topViewController(), first);
        EXPECT_EQ(visible(), navigationPeer().topPage()->widget());
        EXPECT_EQ(second->appearanceState(), kit::AppearanceState::Disappeared);
    }
    stack->setViewControllers({third, second, first}, true);
    settle();
    EXPECT_EQ(shownTitle(), "First");
    EXPECT_EQ(visible(), navigationPeer().topPage()->widget());
}

/// A window manager tells by a property that it has minimised the window.
void setMinimized(GtkWindow* window, bool isMinimized)
{
    auto* surface = gtk_native_get_surface(GTK_NATIVE(window));
    auto* display = gdk_surface_get_display(surface);
    const auto atom = [display](
                          const char* name) { return gdk_x11_get_xatom_by_name_for_display(display, name); };
    const Atom hidden = atom("_NET_WM_STATE_HIDDEN");
    XChangeProperty(gdk_x11_display_get_xdisplay(display), gdk_x11_surface_get_xid(surface),
        atom("_NET_WM_STATE"), XA_ATOM, 32, PropModeReplace, reinterpret_cast<const unsigned char*>(&hidden),
        isMinimized ? 1 : 0);
}

TEST_F(NavigationTests, TheWindowTellsWhenItIsMinimisedAndShownAgain)
{
    show(makeScreen("First"));
    std::vector<bool> told;
    peer().setOnMinimized([&told](bool isMinimized) { told.push_back(isMinimized); });
    for (const bool isMinimized : {true, false}) {
        const auto before = told.size();
        setMinimized(peer().window(), isMinimized);
        waitFor([&] { return told.size() > before; }, "the window's state");
        EXPECT_EQ(told.back(), isMinimized);
    }
}

TEST_F(NavigationTests, ASwipeTakesTheModelAlong)
{
    const auto first = makeScreen("First"), second = makeScreen("Second");
    const auto stack = showStack({first, second});
    // A swipe makes the leaflet go back by itself, as this call does.
    EXPECT_TRUE(adw_leaflet_navigate(navigationPeer().leaflet(), ADW_NAVIGATION_DIRECTION_BACK));
    settle();
    EXPECT_EQ(stack->topViewController(), first);
    EXPECT_TRUE(first->isViewLoaded());
    EXPECT_EQ(peerOf(*first->view())->widget(),
        gtk_widget_get_next_sibling(navigationPeer().topPage()->navigationBar().widget()));
}

TEST_F(NavigationTests, BarsFollowTheScreen)
{
    const auto screen = makeScreen("One");
    int presses = 0;
    const auto item = std::make_shared<kit::BarButtonItem>("Select", [&](const auto&) { ++presses; });
    const auto stack = showStack({screen});
    screen->navigationItem().setRightItem(item);
    screen->setToolbarItems({std::make_shared<kit::BarButtonItem>(kit::SystemItem::FlexibleSpace),
        std::make_shared<kit::BarButtonItem>("Move", [&](const auto&) { presses += 10; })});
    stack->setToolbarHidden(false);
    settle();
    ASSERT_TRUE(findButton("Select") && findButton("Move"));
    g_signal_emit_by_name(findButton("Select"), "clicked");
    g_signal_emit_by_name(findButton("Move"), "clicked");
    EXPECT_EQ(presses, 11);

    item->setEnabled(false);
    settle();
    EXPECT_FALSE(gtk_widget_is_sensitive(findButton("Select")));
    screen->navigationItem().setRightItem(nullptr);
    settle();
    EXPECT_EQ(findButton("Select"), nullptr);
}

class AlertTests : public testing_support::WindowFixture {
protected:
    void present(const std::shared_ptr<kit::AlertController>& alert)
    {
        root = makeScreen("Root");
        show(root);
        root->presentViewController(alert, true);
        settle();
    }
    std::shared_ptr<kit::ViewController> root;
};

TEST_F(AlertTests, TheKeyboardGoesThroughAnAlertAndBack)
{
    root = makeScreen("Root");
    const auto below = std::make_shared<kit::TextField>("below");
    below->setFrame({20, 20, 200, 50});
    root->view()->addSubview(below);
    show(root);
    below->becomeFirstResponder();
    settle();
    const auto focus = [this] { return gtk_root_get_focus(GTK_ROOT(windowWidget())); };
    auto* before = focus();
    ASSERT_NE(before, nullptr);

    const auto alert =
        std::make_shared<kit::AlertController>("Rename", "Enter a name.", kit::AlertStyle::Alert);
    alert->addTextField([](kit::TextField& field) { field.setText("Plans"); });
    const auto cancel = std::make_shared<kit::AlertAction>("Cancel", kit::AlertActionStyle::Default);
    alert->addAction(cancel);
    const auto done = std::make_shared<kit::AlertAction>("Done", kit::AlertActionStyle::Default);
    alert->addAction(done);
    alert->setEscapeAction(cancel);
    root->presentViewController(alert, true);
    settle();
    EXPECT_FALSE(gtk_widget_grab_focus(peer().rootPeer()->widget()))
        << "the screen below takes no focus while the alert is shown";
    EXPECT_GE(gtk_widget_get_height(peerOf(*alert->textFields().front())->widget()), 44);
    for (const char* next : {"Cancel", "Done"}) {
        gtk_widget_child_focus(windowWidget(), GTK_DIR_TAB_FORWARD);
        settle();
        EXPECT_EQ(focus(), findButton(next)) << "the field that was left does not take the focus along";
    }
    done->setEnabled(false);
    settle();
    EXPECT_FALSE(gtk_widget_is_sensitive(findButton("Done")));
    EXPECT_TRUE(window->backRequested());
    settle();
    EXPECT_EQ(root->presentedViewController(), nullptr);
    EXPECT_EQ(focus(), before);
}

TEST_F(AlertTests, AnAlertIsAsHighAsItsBrokenLines)
{
    const auto alert = std::make_shared<kit::AlertController>(
        "Objekt umbenennen", "Gib einen neuen Namen für dieses Objekt ein.", kit::AlertStyle::Alert);
    alert->addTextField({});
    alert->addAction(std::make_shared<kit::AlertAction>("Fertig", kit::AlertActionStyle::Default));
    present(alert);
    auto* field = peerOf(*alert->textFields().front())->widget();
    auto* scrolled = gtk_widget_get_ancestor(field, GTK_TYPE_SCROLLED_WINDOW);
    auto* adjustment = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(scrolled));
    EXPECT_EQ(gtk_adjustment_get_upper(adjustment), gtk_adjustment_get_page_size(adjustment))
        << "nothing is hidden where the window has the room";
}

class Numbers : public kit::ListViewDataSource {
public:
    std::size_t numberOfRows(const kit::ListView&) const override { return ids.size(); }
    kit::ListRow rowAtIndex(const kit::ListView&, std::size_t index) const override
    {
        kit::ListRow row;
        row.id = ids[index];
        row.title = titles.contains(row.id) ? titles.at(row.id) : "Row " + std::to_string(row.id);
        row.menuName = offersMenus ? "Actions for " + row.title : "";
        return row;
    }
    kit::RowId rowIdAtIndex(const kit::ListView&, std::size_t index) const override { return ids[index]; }

    std::vector<kit::RowId> ids;
    std::map<kit::RowId, std::string> titles;
    bool offersMenus = false;
};

/// Notes the rows whose menu was asked for and those that were activated.
class RowLog : public kit::ListViewDelegate {
public:
    kit::Menu menuForRow(kit::ListView&, std::size_t index) override
    {
        menus.push_back(index);
        return {};
    }
    void rowActivated(kit::ListView&, std::size_t index) override { activated.push_back(index); }

    std::vector<std::size_t> menus, activated;
};

class ListTests : public testing_support::WindowFixture {
protected:
    void showRows(std::size_t count)
    {
        rows->ids.resize(count);
        std::iota(rows->ids.begin(), rows->ids.end(), 1);
        const auto screen = makeScreen("List");
        list->setDataSource(rows);
        list->setAutoresizing({true, true});
        list->setFrame(screen->view()->bounds());
        screen->view()->addSubview(list);
        show(screen);
        list->setFrame({0, 0, window->bounds().width, window->bounds().height});
        list->reloadAll();
        settle();
    }
    host::gtk::ListViewPeer& listPeer() const
    {
        return dynamic_cast<host::gtk::ListViewPeer&>(*peerOf(*list));
    }
    bool isWithin(GtkWidget* row, std::size_t margin) const
    {
        const std::size_t position = host::gtk::ListRowWidget::position(row);
        const auto visible = list->visibleRows();
        return position + margin >= visible.first && position < visible.end() + margin;
    }
    /// Answers whether the widget shows its row. Far from the seen rows it has only the row's name.
    bool matches(GtkWidget* row) const
    {
        const auto wanted = list->row(host::gtk::ListRowWidget::position(row));
        const bool isNamed = !host::gtk::ListRowWidget::isShown(row) && !isWithin(row, 20);
        return host::gtk::ListRowWidget::shown(row) == wanted
            && (isNamed || host::gtk::ListRowWidget::titleText(row) == wanted.title);
    }
    /// Checks that every visible row widget shows the model's row at its place, and soon all existing ones
    /// do.
    void expectRowsMatch()
    {
        EXPECT_FALSE(listPeer().liveRows().empty());
        for (auto* row : listPeer().liveRows()) {
            const auto position = host::gtk::ListRowWidget::position(row);
            ASSERT_LT(position, list->rowCount());
            EXPECT_TRUE(matches(row) || !list->visibleRows().contains(position)) << position;
        }
        const auto match = [this](GtkWidget* row) { return matches(row); };
        waitFor(
            [&] { return std::ranges::all_of(listPeer().liveRows(), match); }, "the rows beside the seen");
    }
    void change(std::vector<kit::RowId> after)
    {
        const auto changes = kit::ListChanges::between(rows->ids, after);
        rows->ids = std::move(after);
        list->apply(changes);
        settle();
    }

    std::shared_ptr<Numbers> rows = std::make_shared<Numbers>();
    std::shared_ptr<kit::ListView> list = std::make_shared<kit::ListView>();
};

TEST_F(ListTests, ARowsButtonOpensItsMenuAndNotTheRow)
{
    rows->offersMenus = true;
    const auto log = std::make_shared<RowLog>();
    list->setListDelegate(log);
    showRows(3);
    const auto menuButton = [&] {
        const auto shown = listPeer().liveRows();
        auto* row = *std::ranges::find(shown, 1U, host::gtk::ListRowWidget::position);
        auto* last = gtk_widget_get_last_child(row);
        return GTK_IS_BUTTON(last) && gtk_widget_get_visible(last) ? last : nullptr;
    };
    auto* button = menuButton();
    ASSERT_NE(button, nullptr);
    EXPECT_GE(gtk_widget_get_width(button), 44);
    EXPECT_GE(gtk_widget_get_height(button), 44);
    g_signal_emit_by_name(button, "clicked");
    EXPECT_EQ(log->menus, std::vector<std::size_t>{1});
    EXPECT_EQ(log->activated, std::vector<std::size_t>());
    list->setSelectionMode(kit::SelectionMode::Multiple);
    list->reloadAll();
    settle();
    EXPECT_EQ(menuButton(), nullptr) << "a check mark is there";
}

TEST_F(ListTests, RowWidgetsMatchTheModelThroughEveryChange)
{
    showRows(500);
    expectRowsMatch();
    change({3, 1, 2, 900, 5, 901});
    expectRowsMatch();
    EXPECT_EQ(listPeer().liveRows().size(), 6U);
    change({901, 900, 5, 3});
    expectRowsMatch();
    rows->titles[5] = "Renamed";
    list->rowChanged(2);
    settle();
    expectRowsMatch();
    change({});
    EXPECT_TRUE(listPeer().liveRows().empty());
    change({7});
    expectRowsMatch();
}

TEST_F(ListTests, ManyChangesElsewhereKeepThePlaceAndTheFocus)
{
    showRows(5000);
    list->scrollToRow(2500, kit::RowPosition::Top, false);
    settle();
    EXPECT_EQ(list->visibleRows().first, 2500U);
    list->focusRow(2503);
    const auto focusedId = [this] {
        auto* focused = gtk_root_get_focus(gtk_widget_get_root(listPeer().listWidget()));
        auto* row = focused ? gtk_widget_get_first_child(focused) : nullptr;
        const bool isRow = row && host::gtk::ListRowWidget::isRow(row);
        return isRow ? host::gtk::ListRowWidget::shown(row).id : 0;
    };
    waitFor([&] { return focusedId() == 2504; }, "the focus to come to the row");
    EXPECT_EQ(list->visibleRows().first, 2500U);
    std::vector<kit::RowId> after;
    for (kit::RowId id = 1; id <= 5000; ++id) {
        after.push_back(id);
        const bool isNear = id > 2490 && id < 2520;
        if (id % 2 == 0 && !isNear)
            after.push_back(100'000 + id);
        if (id % 3 == 0 && !isNear)
            after.pop_back();
    }
    change(after);
    expectRowsMatch();
    EXPECT_EQ(focusedId(), 2504U);
    const auto first = list->visibleRows().first;
    EXPECT_NEAR(static_cast<double>(rows->ids[first]), 2501, 1);

    std::erase(after, 2504U);
    change(after);
    waitFor([&] { return focusedId() == 2505; }, "the focus to come to the row behind");
}

TEST_F(ListTests, RowsFarFromTheSeenOnesHaveNoParts)
{
    showRows(1000);
    expectRowsMatch();
    for (const std::size_t first : {300U, 450U}) {
        list->scrollToRow(first, kit::RowPosition::Top, false);
        settle();
        expectRowsMatch();
        const auto isFit = [this](GtkWidget* row) {
            return isWithin(row, 50) || gtk_widget_get_first_child(row) == nullptr;
        };
        waitFor([&] { return std::ranges::all_of(listPeer().liveRows(), isFit); }, "far rows to be emptied");
        EXPECT_GT(listPeer().liveRows().size(), 150U);
    }
}

TEST_F(ListTests, AHundredThousandRowsCostWhatIsNearTheVisibleOnes)
{
    showRows(100'000);
    EXPECT_LT(listPeer().liveRows().size(), 400U);
    list->scrollToRow(70'000, kit::RowPosition::Top, false);
    settle();
    EXPECT_EQ(list->visibleRows().first, 70'000U);
    expectRowsMatch();
    for (auto* row : listPeer().liveRows()) {
        if (list->visibleRows().contains(host::gtk::ListRowWidget::position(row))) {
            EXPECT_EQ(gtk_widget_get_height(row), static_cast<int>(list->rowHeight()));
        }
    }
}

} // namespace
