// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class Button;
}

namespace host::gtk {

/// Shows a button with a GtkButton. A button that is smaller than a finger still takes touches within 44
/// points around its centre.
class ButtonPeer : public ViewPeer {
public:
    ButtonPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::Button>& button);

protected:
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    void mirrorContent(const kit::Button& button);

    std::weak_ptr<kit::Button> _button;
    GtkWidget *_icon, *_title;
};

/// Makes a GtkButton with the touch area of a ButtonPeer.
GtkWidget* makeTouchButton();

} // namespace host::gtk
