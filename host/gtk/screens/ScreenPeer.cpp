// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/ScreenPeer.h"

#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/screens/NavigationPeer.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/ViewControllerVisitor.h"
#include "platform/Weakly.h"

namespace host::gtk {

namespace {

/// Shows a screen's view at the size of its place.
class PlainScreenPeer : public ScreenPeer {
public:
    PlainScreenPeer(const std::shared_ptr<PeerContext>& context, kit::ViewController& screen)
        : _peer(makePeer(context, screen.view()))
    {
        _peer->setRoot(platform::weakly(screen.view(), [](kit::View& view, platform::Size size) {
            view.setFrame({0, 0, size.width, size.height});
        }));
        gtk_widget_set_hexpand(widget(), TRUE);
        gtk_widget_set_vexpand(widget(), TRUE);
    }

    GtkWidget* widget() const override { return _peer->widget(); }
    void focus() override { gtk_widget_child_focus(widget(), GTK_DIR_TAB_FORWARD); }

private:
    std::shared_ptr<ViewPeer> _peer;
};

class ScreenPeerFactory : public kit::ViewControllerVisitor {
public:
    ScreenPeerFactory(const std::shared_ptr<PeerContext>& context, WindowButtons buttons)
        : _context(context)
        , _buttons(buttons)
    {
    }

    void visit(kit::ViewController& screen) override { makePlain(screen); }
    void visit(kit::AlertController& screen) override { makePlain(screen); }
    void visit(kit::SearchPresentation& screen) override { makePlain(screen); }
    void visit(kit::NavigationController& screen) override
    {
        peer = NavigationPeer::make(_context,
            std::static_pointer_cast<kit::NavigationController>(screen.shared_from_this()), _buttons);
    }

    std::shared_ptr<ScreenPeer> peer;

private:
    void makePlain(kit::ViewController& screen)
    {
        peer = std::make_shared<PlainScreenPeer>(_context, screen);
    }

    const std::shared_ptr<PeerContext>& _context;
    WindowButtons _buttons;
};

} // namespace

std::shared_ptr<ScreenPeer> makeScreenPeer(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<kit::ViewController>& screen, WindowButtons buttons)
{
    ScreenPeerFactory factory(context, buttons);
    screen->accept(factory);
    return factory.peer;
}

} // namespace host::gtk
