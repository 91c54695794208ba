// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"
#include "kit/views/ScrollView.h"

namespace host::gtk {

/// A GtkScrolledWindow around a canvas of the content's size.
class ScrollViewPeer : public ViewPeer, public platform::ui::ScrollObserver {
public:
    ScrollViewPeer(
        std::shared_ptr<PeerContext> context, const std::shared_ptr<platform::ui::ScrollView>& scrollView);
    ~ScrollViewPeer() override;

    void scrollTo(platform::ui::ScrollView& view, platform::Point offset, bool animated) override;
    void scrollExtentDidChange(platform::ui::ScrollView& view) override;

protected:
    GtkWidget* childContainer() const override { return _content.get(); }
    platform::Point childOrigin() const override;
    void mirror(platform::ui::View& view, platform::ui::ViewChanges changes) override;

private:
    class Content;
    void adjusted();
    void mirrorBehavior(const platform::ui::ScrollView& view);

    std::weak_ptr<platform::ui::ScrollView> _scrollView;
    ObjectRef<GtkWidget> _content;
    std::unique_ptr<Content> _contentClient;
    SignalConnection _onHorizontal, _onVertical;
};

} // namespace host::gtk
