// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ActivityIndicatorPeer.h"

#include "kit/views/ActivityIndicator.h"

namespace host::gtk {

ActivityIndicatorPeer::ActivityIndicatorPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ActivityIndicator>& indicator)
    : ViewPeer(std::move(context), indicator)
    , _indicator(indicator)
{
    setNative(gtk_spinner_new());
}

void ActivityIndicatorPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto indicator = _indicator.lock();
    if (!indicator || !changes.contains(kit::ViewChange::Content))
        return;
    gtk_widget_set_visible(native(), indicator->isAnimating());
    gtk_spinner_set_spinning(GTK_SPINNER(native()), indicator->isAnimating());
}

} // namespace host::gtk
