// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/FirstList.h"
#include "host/gtk/base/FrameScheduler.h"
#include "host/gtk/base/ObjectRef.h"
#include "host/gtk/base/Theme.h"

#include <gtk/gtk.h>

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <unordered_map>

namespace kit {
class BarButtonItem;
class HostedView;
class View;
} // namespace kit

namespace host::gtk {

class ViewPeer;

/// Makes the native widget of a hosted view and keeps it up to date. It is called for each change of the
/// settings with the widget that it answered last, null at first.
using HostedViewMaker = std::function<ObjectRef<GtkWidget>(kit::HostedView& view, GtkWidget* current)>;

/// The objects that the peers of one window share: the theme, the frames, and which peer shows which view.
/// Main thread only.
class PeerContext {
public:
    PeerContext(std::shared_ptr<Theme> theme, std::shared_ptr<FrameScheduler> scheduler);

    Theme& theme() const { return *_theme; }
    FrameScheduler& scheduler() const { return *_scheduler; }
    FirstList& firstList() { return _firstList; }

    void add(const kit::View& view, ViewPeer& peer);
    void remove(const kit::View& view, const ViewPeer& peer);
    /// Answers the peer that shows a view, or null.
    ViewPeer* peerOf(const kit::View& view) const;

    void setWidget(const kit::BarButtonItem& item, GtkWidget* widget);
    void removeWidget(const kit::BarButtonItem& item, const GtkWidget* widget);
    /// Answers the widget that shows an item of a bar, or null.
    GtkWidget* widgetOf(const kit::BarButtonItem& item) const;

    void setHostedViewMaker(const std::string& kind, HostedViewMaker maker);
    const HostedViewMaker* hostedViewMaker(const std::string& kind) const;

    /// Colours or fonts have changed, so every peer shows its view again.
    void themeDidChange();

private:
    std::shared_ptr<Theme> _theme;
    std::shared_ptr<FrameScheduler> _scheduler;
    FirstList _firstList;
    std::unordered_map<const kit::View*, ViewPeer*> _peers;
    std::unordered_map<const kit::BarButtonItem*, GtkWidget*> _itemWidgets;
    std::map<std::string, HostedViewMaker> _makers;
};

} // namespace host::gtk
