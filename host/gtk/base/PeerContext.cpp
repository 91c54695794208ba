// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/PeerContext.h"

#include "host/gtk/base/ViewPeer.h"

#include <vector>

namespace host::gtk {

PeerContext::PeerContext(std::shared_ptr<Theme> theme, std::shared_ptr<FrameScheduler> scheduler)
    : _theme(std::move(theme))
    , _scheduler(std::move(scheduler))
{
}

void PeerContext::add(const kit::View& view, ViewPeer& peer)
{
    _peers.insert_or_assign(&view, &peer);
}

void PeerContext::remove(const kit::View& view, const ViewPeer& peer)
{
    const auto found = _peers.find(&view);
    if (found != _peers.end() && found->second == &peer)
        _peers.erase(found);
}

ViewPeer* PeerContext::peerOf(const kit::View& view) const
{
    const auto found = _peers.find(&view);
    return found == _peers.end() ? nullptr : found->second;
}

void PeerContext::setWidget(const kit::BarButtonItem& item, GtkWidget* widget)
{
    _itemWidgets.insert_or_assign(&item, widget);
}

void PeerContext::removeWidget(const kit::BarButtonItem& item, const GtkWidget* widget)
{
    const auto found = _itemWidgets.find(&item);
    if (found != _itemWidgets.end() && found->second == widget)
        _itemWidgets.erase(found);
}

GtkWidget* PeerContext::widgetOf(const kit::BarButtonItem& item) const
{
    const auto found = _itemWidgets.find(&item);
    return found == _itemWidgets.end() ? nullptr : found->second;
}

void PeerContext::setHostedViewMaker(const std::string& kind, HostedViewMaker maker)
{
    _makers.insert_or_assign(kind, std::move(maker));
}

const HostedViewMaker* PeerContext::hostedViewMaker(const std::string& kind) const
{
    const auto found = _makers.find(kind);
    return found == _makers.end() ? nullptr : &found->second;
}

void PeerContext::themeDidChange()
{
    for (const auto& [view, peer] : _peers)
        peer->showAnew();
}

} // namespace host::gtk
