// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/PeerContext.h"

#include <memory>

namespace kit {
class ViewController;
}

namespace host::gtk {

class ViewPeer;

/// Says whether the window's own buttons stand in a screen's bars.
enum class WindowButtons { Shown, Hidden };

/// Shows one screen of the kit with the screens that it contains. Sizes travel from the toolkit to the model:
/// the toolkit gives the screen its place, and the model lays itself out in it while that place is allocated.
class ScreenPeer {
public:
    virtual ~ScreenPeer() = default;
    virtual GtkWidget* widget() const = 0;
    /// Moves the keyboard focus into the screen.
    virtual void focus() = 0;
};

/// Makes the peer for a screen's class: a navigation with its bars, or the view of the screen alone.
std::shared_ptr<ScreenPeer> makeScreenPeer(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons);

} // namespace host::gtk
