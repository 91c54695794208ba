// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"
#include "kit/views/ScrollView.h"

namespace host::gtk {

/// Shows a scroll view with a GtkScrolledWindow around a canvas of the content's size.
class ScrollViewPeer : public ViewPeer, public kit::ScrollObserver {
public:
    ScrollViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ScrollView>& scrollView);
    ~ScrollViewPeer() override;

    void scrollTo(kit::ScrollView& view, platform::Point offset, bool animated) override;
    void scrollExtentDidChange(kit::ScrollView& view) override;

protected:
    GtkWidget* childContainer() const override { return _content.get(); }
    platform::Point childOrigin() const override;
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    class Content;
    void adjusted();
    void followOffset();
    void mirrorBehavior(const kit::ScrollView& view);

    std::weak_ptr<kit::ScrollView> _scrollView;
    ObjectRef<GtkWidget> _content;
    std::unique_ptr<Content> _contentClient;
    SignalConnection _onHorizontal, _onVertical;
};

} // namespace host::gtk
