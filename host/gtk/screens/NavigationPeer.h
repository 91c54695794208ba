// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/SizedBin.h"
#include "host/gtk/screens/ScreenPage.h"
#include "kit/controllers/NavigationObserver.h"
#include "kit/views/ViewObserver.h"

#include <adwaita.h>

#include <vector>

namespace host::gtk {

/// Shows a stack of screens as the pages of an AdwLeaflet. A page is built for the top screen and for the one
/// below it, which a swipe can uncover. A swipe shows that page from its beginning; the model is told of it
/// when it has ended.
///
/// Under X the leaflet's gestures wait for ever for the end of a touch that a list took over;
/// `forgetFingersThatLeft` keeps that fault of the toolkit from the user.
class NavigationPeer : public ScreenPeer,
                       public kit::NavigationObserver,
                       public kit::ViewObserver,
                       public std::enable_shared_from_this<NavigationPeer> {
public:
    static std::shared_ptr<NavigationPeer> make(const std::shared_ptr<PeerContext>& context,
        const std::shared_ptr<kit::NavigationController>& navigation, WindowButtons buttons);
    NavigationPeer(std::shared_ptr<PeerContext> context,
        const std::shared_ptr<kit::NavigationController>& navigation, WindowButtons buttons);
    ~NavigationPeer() override;

    GtkWidget* widget() const override { return _bin.widget(); }
    void focus() override;

    AdwLeaflet* leaflet() const { return ADW_LEAFLET(_leaflet.get()); }
    /// Answers the page of the screen on top, or null when the stack is empty.
    std::shared_ptr<ScreenPage> topPage() const;

    void navigationWillTransition(kit::NavigationController& controller,
        const kit::NavigationTransition& transition, kit::TransitionToken token) override;
    void stackDidChange(kit::NavigationController& controller) override;
    void toolbarVisibilityDidChange(kit::NavigationController& controller, bool animated) override;
    void viewDidChange(kit::View& view, kit::ViewChanges changes) override;

private:
    using Screen = std::shared_ptr<kit::ViewController>;
    std::shared_ptr<ScreenPage> pageOf(const Screen& screen);
    std::shared_ptr<ScreenPage> knownPageOf(const Screen& screen) const;
    void showWithoutMovement(const Screen& screen);
    void showMoving(const kit::NavigationTransition& transition);
    void forgetFingersThatLeft();
    void transitionRunningChanged();
    void swipedAway(const ScreenPage& top);
    void settle();
    void removeStalePages();
    void ensurePageBelowTop();
    void updateAll();
    void hideAllButTop() const;

    std::shared_ptr<PeerContext> _context;
    std::weak_ptr<kit::NavigationController> _navigation;
    WindowButtons _buttons;
    SizedBin _bin;
    ObjectRef<GtkWidget> _leaflet;
    std::vector<std::shared_ptr<ScreenPage>> _pages; ///< in the order of the leaflet
    kit::TransitionToken _token;
    bool _mirroring = false; ///< the program moves the pages, not the user
    SignalConnections _connections;
};

} // namespace host::gtk
