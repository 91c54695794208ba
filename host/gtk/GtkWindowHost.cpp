#include "host/gtk/GtkWindowHost.h"

namespace host::gtk {

GtkWindowHost::GtkWindowHost(
    AdwApplication* application, const WindowSize& size, std::shared_ptr<PreviewModule> previews)
    : _application(application)
    , _size(size)
    , _previews(std::move(previews))
{
}

void GtkWindowHost::showWindow(const std::shared_ptr<platform::ui::Window>& window)
{
    if (_peer && _peer->model() == window) {
        _peer->show();
        return;
    }
    _peer = WindowPeer::make(_application, window, _size, _previews);
    if (_onShow)
        _onShow(*_peer);
    _peer->show();
}

} // namespace host::gtk
