// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/screens/BarItemPeer.h"

#include <vector>

namespace host::gtk {

/// The bar at the bottom of a screen.
class ToolbarPeer {
public:
    explicit ToolbarPeer(std::shared_ptr<PeerContext> context);
    ~ToolbarPeer();

    GtkWidget* widget() const { return _bar.get(); }
    /// Shows these items from now on, and does nothing when they are shown already.
    void show(const kit::BarButtonItems& items);
    void setHidden(bool hidden);

private:
    void clear();
    void append(const std::shared_ptr<kit::BarButtonItem>& item, bool viewTakesAll);

    std::shared_ptr<PeerContext> _context;
    ObjectRef<GtkWidget> _bar;
    GtkWidget* _box;
    kit::BarButtonItems _items;
    std::vector<std::shared_ptr<BarItemPeer>> _peers;
};

} // namespace host::gtk
