// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class HostedView;
}

namespace host::gtk {

/// Shows the native view that the context's maker for the kind makes. Without a maker it is empty space.
class HostedViewPeer : public ViewPeer {
public:
    HostedViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::HostedView>& hosted);

protected:
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    std::weak_ptr<kit::HostedView> _hosted;
};

} // namespace host::gtk
