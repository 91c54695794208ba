// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace platform::ui {
class ActivityIndicator;
}

namespace host::gtk {

/// A GtkSpinner.
class ActivityIndicatorPeer : public ViewPeer {
public:
    ActivityIndicatorPeer(std::shared_ptr<PeerContext> context,
        const std::shared_ptr<platform::ui::ActivityIndicator>& indicator);

protected:
    void mirror(platform::ui::View& view, platform::ui::ViewChanges changes) override;

private:
    std::weak_ptr<platform::ui::ActivityIndicator> _indicator;
};

} // namespace host::gtk
