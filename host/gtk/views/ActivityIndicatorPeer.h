// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class ActivityIndicator;
}

namespace host::gtk {

/// Shows an activity indicator with a GtkSpinner.
class ActivityIndicatorPeer : public ViewPeer {
public:
    ActivityIndicatorPeer(
        std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ActivityIndicator>& indicator);

protected:
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    std::weak_ptr<kit::ActivityIndicator> _indicator;
};

} // namespace host::gtk
