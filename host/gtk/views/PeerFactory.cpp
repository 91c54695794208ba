// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/views/ActivityIndicatorPeer.h"
#include "host/gtk/views/ButtonPeer.h"
#include "host/gtk/views/HostedViewPeer.h"
#include "host/gtk/views/ImageViewPeer.h"
#include "host/gtk/views/LabelPeer.h"
#include "host/gtk/views/ListViewPeer.h"
#include "host/gtk/views/ScrollViewPeer.h"
#include "host/gtk/views/TextFieldPeer.h"
#include "kit/views/ActivityIndicator.h"
#include "kit/views/Button.h"
#include "kit/views/HostedView.h"
#include "kit/views/ImageView.h"
#include "kit/views/ListView.h"
#include "kit/views/TextField.h"
#include "kit/views/ViewVisitor.h"

namespace host::gtk {

namespace {

class PeerFactory : public kit::ViewVisitor {
public:
    explicit PeerFactory(const std::shared_ptr<PeerContext>& context)
        : _context(context)
    {
    }

    void visit(kit::View& view) override { make<ViewPeer>(view); }
    void visit(kit::Label& view) override { make<LabelPeer>(view); }
    void visit(kit::ImageView& view) override { make<ImageViewPeer>(view); }
    void visit(kit::Button& view) override { make<ButtonPeer>(view); }
    void visit(kit::TextField& view) override { make<TextFieldPeer>(view); }
    void visit(kit::ScrollView& view) override { make<ScrollViewPeer>(view); }
    void visit(kit::ListView& view) override { make<ListViewPeer>(view); }
    void visit(kit::ActivityIndicator& view) override { make<ActivityIndicatorPeer>(view); }
    void visit(kit::HostedView& view) override { make<HostedViewPeer>(view); }

    std::shared_ptr<ViewPeer> peer;

private:
    template <typename Peer, typename Model>
    void make(Model& view)
    {
        peer = std::make_shared<Peer>(_context, std::static_pointer_cast<Model>(view.shared_from_this()));
    }

    const std::shared_ptr<PeerContext>& _context;
};

} // namespace

std::shared_ptr<ViewPeer> makePeer(
    const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::View>& view)
{
    PeerFactory factory(context);
    view->accept(factory);
    factory.peer->start();
    return factory.peer;
}

} // namespace host::gtk
