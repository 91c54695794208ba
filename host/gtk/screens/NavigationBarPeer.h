// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/screens/BarItemPeer.h"

#include "kit/values/Menu.h"

#include <functional>
#include <vector>

namespace kit {
class NavigationItem;
}

namespace host::gtk {

/// The bar at the top of a screen.
class NavigationBarPeer {
public:
    explicit NavigationBarPeer(std::shared_ptr<PeerContext> context);
    ~NavigationBarPeer();

    GtkWidget* widget() const { return _bar.get(); }
    GtkWidget* backButton() const { return _back; }
    void setOnBack(std::function<void()> callback) { _onBack = std::move(callback); }

    /// Shows an item. `hasBackTarget` says whether there is a screen to go back to.
    void show(const kit::NavigationItem& item, bool hasBackTarget);
    /// A narrow bar shows only the close button of the window's buttons, and the compact images of its items.
    void setNarrow(bool narrow);
    /// Says whether the window's own buttons stand in this bar.
    void setWindowButtons(bool shown);

private:
    void showItems(const kit::NavigationItem& item);
    void showSearch(const kit::NavigationItem& item);
    void showMenuButton(const kit::NavigationItem& item);
    void clearItems();

    std::shared_ptr<PeerContext> _context;
    ObjectRef<GtkWidget> _bar;
    GtkWidget *_title, *_back, *_search, *_menu;
    kit::BarButtonItems _left, _right;
    std::vector<std::shared_ptr<BarItemPeer>> _peers;
    GtkEventController* _newKey = nullptr;
    std::function<void()> _onBack, _onSearch, _onNew;
    std::function<kit::Menu()> _makeMenu;
    SignalConnections _connections;
    bool _isNarrow = false;
};

} // namespace host::gtk
