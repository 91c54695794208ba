// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace platform::ui {
class HostedView;
}

namespace host::gtk {

/// The native view that the context's maker of the kind makes; without such a maker, empty space.
class HostedViewPeer : public ViewPeer {
public:
    HostedViewPeer(
        std::shared_ptr<PeerContext> context, const std::shared_ptr<platform::ui::HostedView>& hosted);

protected:
    void mirror(platform::ui::View& view, platform::ui::ViewChanges changes) override;

private:
    std::weak_ptr<platform::ui::HostedView> _hosted;
};

} // namespace host::gtk
