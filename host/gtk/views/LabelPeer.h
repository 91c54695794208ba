// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class Label;
}

namespace host::gtk {

/// Shows a label with a GtkLabel. A styled text with images is drawn by the peer; the GtkLabel below then
/// only serves assistive technology.
class LabelPeer : public ViewPeer {
public:
    LabelPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::Label>& label);

    void canvasSnapshot(GtkSnapshot* snapshot) override;

protected:
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    std::weak_ptr<kit::Label> _label;
};

/// Makes a GtkLabel show the text of a label of the kit.
void showLabel(GtkLabel* widget, const kit::Label& label, const Theme& theme);

} // namespace host::gtk
