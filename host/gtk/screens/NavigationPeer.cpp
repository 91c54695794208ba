// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/NavigationPeer.h"

#include "host/gtk/base/ViewPeer.h"
#include "kit/controllers/NavigationController.h"
#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {

std::shared_ptr<NavigationPeer> NavigationPeer::make(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<kit::NavigationController>& navigation, WindowButtons buttons)
{
    auto peer = std::make_shared<NavigationPeer>(context, navigation, buttons);
    navigation->view()->setObserver(peer);
    navigation->setNavigationObserver(peer);
    if (const auto top = navigation->topViewController())
        peer->showWithoutMovement(top);
    return peer;
}

NavigationPeer::NavigationPeer(std::shared_ptr<PeerContext> context,
    const std::shared_ptr<kit::NavigationController>& navigation, WindowButtons buttons)
    : _context(std::move(context))
    , _navigation(navigation)
    , _buttons(buttons)
    , _bin(platform::weakly(navigation,
          [](kit::NavigationController& stack, platform::Size size) {
              stack.view()->setFrame({0, 0, size.width, size.height});
          }))
    , _leaflet(ObjectRef<GtkWidget>::retain(adw_leaflet_new()))
{
    adw_leaflet_set_can_unfold(leaflet(), FALSE);
    adw_leaflet_set_transition_type(leaflet(), ADW_LEAFLET_TRANSITION_TYPE_SLIDE);
    _bin.setChild(_leaflet.get());
    forgetFingersThatLeft();
    _connections.push_back(connectNotify(
        _leaflet.get(), "notify::child-transition-running", [this] { transitionRunningChanged(); }));
}

/// Resets the leaflet's gestures when a first finger touches. Under X they otherwise wait for ever for the
/// end of a touch that a list inside took over, and follow no finger any more.
void NavigationPeer::forgetFingersThatLeft()
{
    auto* events = gtk_event_controller_legacy_new();
    gtk_event_controller_set_propagation_phase(events, GTK_PHASE_CAPTURE);
    gtk_widget_add_controller(_leaflet.get(), events);
    _connections.push_back(connectSignal<gboolean(GdkEvent*)>(events, "event", [this](GdkEvent* event) {
        const bool isFirstFinger = gdk_event_get_event_type(event) == GDK_TOUCH_BEGIN
            && gdk_touch_event_get_emulating_pointer(event);
        const auto controllers = ObjectRef<GListModel>::adopt(gtk_widget_observe_controllers(_leaflet.get()));
        for (guint i = 0; isFirstFinger && i < g_list_model_get_n_items(controllers.get()); ++i) {
            const auto controller =
                ObjectRef<GObject>::adopt(static_cast<GObject*>(g_list_model_get_item(controllers.get(), i)));
            if (GTK_IS_GESTURE(controller.get()))
                gtk_event_controller_reset(GTK_EVENT_CONTROLLER(controller.get()));
        }
        return FALSE;
    }));
}

NavigationPeer::~NavigationPeer()
{
    _connections.clear();
    _context->scheduler().cancel(this);
    _context->scheduler().cancel(&_pages);
    for (const auto& page : _pages)
        adw_leaflet_remove(leaflet(), page->widget());
}

void NavigationPeer::focus()
{
    if (const auto page = topPage())
        page->focus();
}

std::shared_ptr<ScreenPage> NavigationPeer::topPage() const
{
    const auto stack = _navigation.lock();
    return stack ? knownPageOf(stack->topViewController()) : nullptr;
}

std::shared_ptr<ScreenPage> NavigationPeer::knownPageOf(const Screen& screen) const
{
    const auto found =
        std::ranges::find_if(_pages, [&](const auto& page) { return page->screen() == screen; });
    return screen && found != _pages.end() ? *found : nullptr;
}

std::shared_ptr<ScreenPage> NavigationPeer::pageOf(const Screen& screen)
{
    if (auto known = knownPageOf(screen))
        return known;
    const auto stack = _navigation.lock();
    auto page = ScreenPage::make(_context, stack, screen, _buttons);
    adw_leaflet_append(leaflet(), page->widget());
    _pages.push_back(page);
    return page;
}

void NavigationPeer::navigationWillTransition(
    kit::NavigationController&, const kit::NavigationTransition& transition, kit::TransitionToken token)
{
    _token.finish();
    _token = std::move(token);
    if (!transition.to) {
        removeStalePages();
        settle();
        return;
    }
    const bool moves = transition.animated && transition.from && _context->theme().animationsEnabled()
        && gtk_widget_get_mapped(_leaflet.get()) && transition.kind != kit::NavigationKind::Replace;
    if (moves)
        showMoving(transition);
    else
        showWithoutMovement(transition.to);
}

void NavigationPeer::showMoving(const kit::NavigationTransition& transition)
{
    _mirroring = true;
    const auto page = pageOf(transition.to);
    page->load();
    const auto from = knownPageOf(transition.from);
    if (from && transition.kind == kit::NavigationKind::Pop) {
        // A page that was made only now comes after the leaving one, although it lies below it.
        adw_leaflet_reorder_child_after(leaflet(), from->widget(), page->widget());
    } else if (from) {
        adw_leaflet_reorder_child_after(leaflet(), page->widget(), from->widget());
    }
    adw_leaflet_set_visible_child(leaflet(), page->widget());
    _mirroring = false;
    updateAll();
    if (!adw_leaflet_get_child_transition_running(leaflet()))
        settle();
}

void NavigationPeer::showWithoutMovement(const Screen& screen)
{
    _mirroring = true;
    // The leaflet slides only from one page to another, so the first page just appears.
    auto before = std::exchange(_pages, {});
    for (const auto& page : before)
        adw_leaflet_remove(leaflet(), page->widget());
    const auto known =
        std::ranges::find_if(before, [&](const auto& page) { return page->screen() == screen; });
    if (known != before.end()) {
        adw_leaflet_append(leaflet(), (*known)->widget());
        _pages.push_back(*known);
    }
    const auto page = pageOf(screen);
    page->load();
    for (auto& gone : before) {
        if (gone != page)
            _context->scheduler().release(std::move(gone));
    }
    adw_leaflet_set_visible_child(leaflet(), page->widget());
    _mirroring = false;
    settle();
}

void NavigationPeer::transitionRunningChanged()
{
    if (_mirroring || adw_leaflet_get_child_transition_running(leaflet()))
        return;
    const auto top = topPage();
    auto* visible = adw_leaflet_get_visible_child(leaflet());
    if (top && visible && visible != top->widget())
        swipedAway(*top);
    else
        settle();
}

/// A swipe shows the page below from its beginning, and only its end tells whether the user went back. When
/// the model does not go back, the top page is shown again.
void NavigationPeer::swipedAway(const ScreenPage& top)
{
    const auto keepsSelf = shared_from_this();
    const auto stack = _navigation.lock();
    if (stack && stack->userWentBack())
        return;
    _mirroring = true;
    adw_leaflet_set_visible_child(leaflet(), top.widget());
    _mirroring = false;
}

/// The movement has ended: the waiting callbacks run, and the pages are put in order in the next frame.
void NavigationPeer::settle()
{
    const auto keepsSelf = weak_from_this().lock();
    std::exchange(_token, {}).finish();
    updateAll();
    _context->scheduler().schedule(&_pages, [this] {
        if (adw_leaflet_get_child_transition_running(leaflet()))
            return;
        removeStalePages();
        ensurePageBelowTop();
    });
}

void NavigationPeer::removeStalePages()
{
    const auto stack = _navigation.lock();
    if (!stack)
        return;
    const auto& screens = stack->viewControllers();
    const auto isStale = [&](const std::shared_ptr<ScreenPage>& page) {
        return std::ranges::find(screens, page->screen()) == screens.end();
    };
    _mirroring = true;
    for (auto& page : _pages) {
        if (!isStale(page))
            continue;
        adw_leaflet_remove(leaflet(), page->widget());
        _context->scheduler().release(std::exchange(page, nullptr));
    }
    std::erase(_pages, nullptr);
    _mirroring = false;
}

void NavigationPeer::ensurePageBelowTop()
{
    const auto stack = _navigation.lock();
    if (!stack || stack->viewControllers().size() < 2)
        return;
    const auto& screens = stack->viewControllers();
    const auto top = topPage();
    const auto& below = screens[screens.size() - 2];
    if (!top)
        return;
    _mirroring = true;
    const auto page = pageOf(below);
    adw_leaflet_reorder_child_after(leaflet(), top->widget(), page->widget());
    adw_leaflet_set_visible_child(leaflet(), top->widget());
    _mirroring = false;
    hideAllButTop();
}

/// Hides all pages but the top one. The leaflet does not draw the others, but it leaves them visible to
/// assistive technology, and the leaving one to touches.
void NavigationPeer::hideAllButTop() const
{
    const auto top = topPage();
    for (const auto& page : _pages) {
        gtk_widget_set_can_target(page->widget(), page == top);
        gtk_accessible_update_state(
            GTK_ACCESSIBLE(page->widget()), GTK_ACCESSIBLE_STATE_HIDDEN, page != top ? TRUE : FALSE, -1);
    }
}

void NavigationPeer::updateAll()
{
    hideAllButTop();
    if (const auto stack = _navigation.lock())
        adw_leaflet_set_can_navigate_back(leaflet(), stack->canGoBack());
    for (const auto& page : _pages)
        page->updateBars();
}

void NavigationPeer::stackDidChange(kit::NavigationController&)
{
    settle();
}

void NavigationPeer::toolbarVisibilityDidChange(kit::NavigationController&, bool /*animated*/)
{
    updateAll();
}

void NavigationPeer::viewDidChange(kit::View&, kit::ViewChanges changes)
{
    if (!changes.contains(kit::ViewChange::Layout))
        return;
    _context->scheduler().schedule(this, [this] {
        if (const auto stack = _navigation.lock())
            stack->view()->layoutIfNeeded();
    });
}

} // namespace host::gtk
