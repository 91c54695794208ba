// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/GtkWindowHost.h"

namespace host::gtk {

namespace {

/// Shows the window after the work that waits on the main queue. The toolkit would otherwise draw the
/// window's first frame before, and the results of that work, such as the rows of a list, would appear only
/// in the second frame.
void showAfterWaitingWork(const std::weak_ptr<WindowPeer>& peer)
{
    using Held = std::weak_ptr<WindowPeer>;
    const auto show = [](gpointer held) -> gboolean {
        if (const auto shown = static_cast<Held*>(held)->lock())
            shown->show();
        return G_SOURCE_REMOVE;
    };
    // The main queue has the same priority and was posted to before.
    g_idle_add_full(GDK_PRIORITY_REDRAW, show, std::make_unique<Held>(peer).release(),
        [](gpointer held) { delete static_cast<Held*>(held); });
}

} // namespace

GtkWindowHost::GtkWindowHost(
    AdwApplication* application, const WindowSize& size, std::shared_ptr<PreviewModule> previews)
    : _application(application)
    , _size(size)
    , _previews(std::move(previews))
{
}

void GtkWindowHost::showWindow(const std::shared_ptr<kit::Window>& window)
{
    if (_peer && _peer->model() == window) {
        _peer->show();
        return;
    }
    _peer = WindowPeer::make(_application, window, _size, _previews);
    if (_onShow)
        _onShow(*_peer);
    showAfterWaitingWork(_peer);
}

} // namespace host::gtk
