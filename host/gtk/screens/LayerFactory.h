// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PeerContext.h"
#include "host/gtk/screens/PresentedLayer.h"
#include "platform/Geometry.h"

#include <memory>

namespace kit {
class ViewController;
}

namespace host::gtk {

/// Names where layers are added: to `overlay`, popovers to `canvas`; the size is that of the window.
struct LayerSite {
    GtkOverlay* overlay;
    GtkWidget* canvas;
    platform::Size size;
};

/// Makes the layer of a presented screen, by the screen's class, its style and the window's width. In a
/// narrow window an action sheet stands at the bottom edge, in a wide one it is a popover at its anchor.
std::unique_ptr<PresentedLayer> makeLayer(const std::shared_ptr<PeerContext>& context, const LayerSite& site,
    const std::shared_ptr<kit::ViewController>& screen);

/// A window of at least this width shows popovers and sheets. In a narrower one a screen fills the window.
inline constexpr double wideWindow = 600; ///< points

} // namespace host::gtk
