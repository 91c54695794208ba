// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/ScreenPeer.h"

#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/screens/NavigationPeer.h"
#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/SearchPresentation.h"
#include "kit/controllers/ViewControllerVisitor.h"

namespace host::gtk {

namespace ui = platform::ui;

namespace {

/// The view of a screen at the size of its place.
class PlainScreenPeer : public ScreenPeer {
public:
    PlainScreenPeer(const std::shared_ptr<PeerContext>& context, ui::ViewController& screen)
        : _peer(makePeer(context, screen.view()))
    {
        const std::weak_ptr<ui::View> weak = screen.view();
        _peer->setRoot([weak](platform::Size size) {
            if (const auto view = weak.lock())
                view->setFrame({0, 0, size.width, size.height});
        });
        gtk_widget_set_hexpand(widget(), TRUE);
        gtk_widget_set_vexpand(widget(), TRUE);
    }

    GtkWidget* widget() const override { return _peer->widget(); }
    void focus() override { gtk_widget_child_focus(widget(), GTK_DIR_TAB_FORWARD); }

private:
    std::shared_ptr<ViewPeer> _peer;
};

class ScreenPeerFactory : public ui::ViewControllerVisitor {
public:
    ScreenPeerFactory(const std::shared_ptr<PeerContext>& context, WindowButtons buttons)
        : _context(context)
        , _buttons(buttons)
    {
    }

    void visit(ui::ViewController& screen) override { makePlain(screen); }
    void visit(ui::AlertController& screen) override { makePlain(screen); }
    void visit(ui::SearchPresentation& screen) override { makePlain(screen); }
    void visit(ui::NavigationController& screen) override
    {
        peer = NavigationPeer::make(_context,
            std::static_pointer_cast<ui::NavigationController>(screen.shared_from_this()), _buttons);
    }

    std::shared_ptr<ScreenPeer> peer;

private:
    void makePlain(ui::ViewController& screen) { peer = std::make_shared<PlainScreenPeer>(_context, screen); }

    const std::shared_ptr<PeerContext>& _context;
    WindowButtons _buttons;
};

} // namespace

std::shared_ptr<ScreenPeer> makeScreenPeer(const std::shared_ptr<PeerContext>& context,
    const std::shared_ptr<ui::ViewController>& screen, WindowButtons buttons)
{
    ScreenPeerFactory factory(context, buttons);
    screen->accept(factory);
    return factory.peer;
}

} // namespace host::gtk
