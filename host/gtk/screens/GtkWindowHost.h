// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/screens/WindowPeer.h"
#include "kit/controllers/WindowHost.h"

#include <functional>
#include <memory>

namespace host::gtk {

/// Shows the application's window. Main thread only.
class GtkWindowHost : public kit::WindowHost {
public:
    /// `application` may be null; windows then belong to no application.
    GtkWindowHost(
        AdwApplication* application, const WindowSize& size, std::shared_ptr<PreviewModule> previews);

    void showWindow(const std::shared_ptr<kit::Window>& window) override;
    /// Answers the window that is shown, or null.
    const std::shared_ptr<WindowPeer>& windowPeer() const { return _peer; }
    /// The callback runs for each window before it is on the screen.
    void setOnShow(std::function<void(WindowPeer&)> callback) { _onShow = std::move(callback); }
    /// Closes the window.
    void close() { _peer.reset(); }

private:
    AdwApplication* _application;
    WindowSize _size;
    std::shared_ptr<PreviewModule> _previews;
    std::shared_ptr<WindowPeer> _peer;
    std::function<void(WindowPeer&)> _onShow;
};

} // namespace host::gtk
