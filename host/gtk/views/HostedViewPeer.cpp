// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/HostedViewPeer.h"

#include "kit/views/HostedView.h"

namespace host::gtk {

HostedViewPeer::HostedViewPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::HostedView>& hosted)
    : ViewPeer(std::move(context), hosted)
    , _hosted(hosted)
{
}

void HostedViewPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    const auto hosted = _hosted.lock();
    if (hosted && changes.contains(kit::ViewChange::Content)) {
        const auto* maker = context().hostedViewMaker(hosted->kind());
        const auto made = maker ? (*maker)(*hosted, native()) : ObjectRef<GtkWidget>();
        if (made.get() != native()) {
            setNative(made.get());
            changes |= kit::ViewChange::Accessibility;
            gtk_widget_queue_allocate(widget());
        }
    }
    ViewPeer::mirror(shown, changes);
}

} // namespace host::gtk
