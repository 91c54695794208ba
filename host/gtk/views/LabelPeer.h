// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace platform::ui {
class Label;
}

namespace host::gtk {

/// A GtkLabel. A styled text with images is drawn by the peer, the label under it then only speaks.
class LabelPeer : public ViewPeer {
public:
    LabelPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<platform::ui::Label>& label);

    void canvasSnapshot(GtkSnapshot* snapshot) override;

protected:
    void mirror(platform::ui::View& view, platform::ui::ViewChanges changes) override;

private:
    std::weak_ptr<platform::ui::Label> _label;
};

/// Makes a GtkLabel show what a label of the kit shows.
void showLabel(GtkLabel* widget, const platform::ui::Label& label, const Theme& theme);

} // namespace host::gtk
