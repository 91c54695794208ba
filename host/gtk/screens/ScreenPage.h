// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/screens/NavigationBarPeer.h"
#include "host/gtk/screens/ScreenPeer.h"
#include "host/gtk/screens/ToolbarPeer.h"
#include "kit/controllers/ViewControllerObserver.h"

#include <memory>

namespace kit {
class NavigationController;
class ViewController;
} // namespace kit

namespace host::gtk {

/// Shows one screen of a navigation controller between its bars.
class ScreenPage : public kit::ViewControllerObserver, public std::enable_shared_from_this<ScreenPage> {
public:
    static std::shared_ptr<ScreenPage> make(const std::shared_ptr<PeerContext>& context,
        const std::shared_ptr<kit::NavigationController>& navigation,
        const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons);
    ScreenPage(std::shared_ptr<PeerContext> context,
        const std::shared_ptr<kit::NavigationController>& navigation,
        const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons);
    ~ScreenPage() override;

    GtkWidget* widget() const { return _box.get(); }
    std::shared_ptr<kit::ViewController> screen() const { return _screen.lock(); }
    NavigationBarPeer& navigationBar() { return _navigationBar; }
    ViewPeer* content() const { return _content.get(); } ///< null until the screen is first shown

    /// Loads the screen's view and shows it, once.
    void load();
    /// Shows the model's bars in the next frame.
    void updateBars();
    void focus();

    void barsDidChange(kit::ViewController& controller) override;

private:
    void mirrorBars();

    std::shared_ptr<PeerContext> _context;
    std::weak_ptr<kit::NavigationController> _navigation;
    std::weak_ptr<kit::ViewController> _screen;
    ObjectRef<GtkWidget> _box;
    NavigationBarPeer _navigationBar;
    ToolbarPeer _toolbar;
    std::shared_ptr<ViewPeer> _content;
    SignalConnection _onMap;
};

} // namespace host::gtk
