// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ScrollViewPeer.h"

#include "platform/Weakly.h"

#include <algorithm>

namespace host::gtk {
using platform::Point;
using platform::Size;

/// The canvas inside the scrolled window, which is as large as the content with its insets.
class ScrollViewPeer::Content : public CanvasClient {
public:
    explicit Content(ScrollViewPeer& peer)
        : _peer(peer)
    {
    }

    Size canvasNaturalSize(double) override
    {
        const auto view = _peer._scrollView.lock();
        if (!view)
            return {};
        const auto content = view->contentSize();
        const auto& insets = view->contentInsets();
        return {content.width + insets.left + insets.right, content.height + insets.top + insets.bottom};
    }
    void canvasAllocate(int, int) override
    {
        _peer.allocateChildren();
        _peer.followOffset();
    }
    void canvasSnapshot(GtkSnapshot* snapshot) override
    {
        CanvasWidget::snapshotChildren(_peer._content.get(), snapshot);
    }
    bool canvasContains(double x, double y) override { return x >= 0 && y >= 0; }

private:
    ScrollViewPeer& _peer;
};

ScrollViewPeer::ScrollViewPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ScrollView>& scrollView)
    : ViewPeer(std::move(context), scrollView)
    , _scrollView(scrollView)
    , _content(ObjectRef<GtkWidget>::retain(CanvasWidget::make(GTK_ACCESSIBLE_ROLE_GROUP)))
    , _contentClient(std::make_unique<Content>(*this))
{
    CanvasWidget::setClient(_content.get(), _contentClient.get());
    auto* window = gtk_scrolled_window_new();
    // The content takes the keyboard focus, and its scrolled window does not.
    gtk_widget_set_focusable(window, FALSE);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(window), _content.get());
    setNative(window);
    auto* horizontal = gtk_scrolled_window_get_hadjustment(GTK_SCROLLED_WINDOW(window));
    auto* vertical = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(window));
    _onHorizontal = connectSignal<void()>(horizontal, "value-changed", [this] { adjusted(); });
    _onVertical = connectSignal<void()>(vertical, "value-changed", [this] { adjusted(); });
}

ScrollViewPeer::~ScrollViewPeer()
{
    CanvasWidget::setClient(_content.get(), nullptr);
}

void ScrollViewPeer::adjusted()
{
    const auto view = _scrollView.lock();
    if (!view)
        return;
    auto* window = GTK_SCROLLED_WINDOW(native());
    const auto& insets = view->contentInsets();
    view->userScrolled({gtk_adjustment_get_value(gtk_scrolled_window_get_hadjustment(window)) - insets.left,
        gtk_adjustment_get_value(gtk_scrolled_window_get_vadjustment(window)) - insets.top});
}

void ScrollViewPeer::scrollTo(kit::ScrollView& view, Point offset, bool /*animated*/)
{
    const SignalBlock horizontal(_onHorizontal), vertical(_onVertical);
    auto* window = GTK_SCROLLED_WINDOW(native());
    const auto& insets = view.contentInsets();
    gtk_adjustment_set_value(gtk_scrolled_window_get_hadjustment(window), offset.x + insets.left);
    gtk_adjustment_set_value(gtk_scrolled_window_get_vadjustment(window), offset.y + insets.top);
}

/// An offset that was set along with a larger content waits for the room that the content gives.
void ScrollViewPeer::followOffset()
{
    const auto view = _scrollView.lock();
    if (!view)
        return;
    auto* vertical = gtk_scrolled_window_get_vadjustment(GTK_SCROLLED_WINDOW(native()));
    const double wanted = view->contentOffset().y + view->contentInsets().top;
    const double reachable =
        std::min(wanted, gtk_adjustment_get_upper(vertical) - gtk_adjustment_get_page_size(vertical));
    if (gtk_adjustment_get_value(vertical) < reachable)
        context().scheduler().schedule(&_onVertical, platform::weakly(this, [](ScrollViewPeer& self) {
            if (const auto scrolled = self._scrollView.lock())
                self.scrollTo(*scrolled, scrolled->contentOffset(), false);
        }));
}

void ScrollViewPeer::scrollExtentDidChange(kit::ScrollView& view)
{
    viewDidChange(view, kit::ViewChange::IntrinsicSize);
}

Point ScrollViewPeer::childOrigin() const
{
    const auto view = _scrollView.lock();
    return view ? Point{view->contentInsets().left, view->contentInsets().top} : Point();
}

void ScrollViewPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    const auto view = _scrollView.lock();
    if (!view)
        return;
    // The widget scrolls by itself, so a new origin of the bounds moves no child.
    ViewPeer::mirror(shown, changes);
    if (changes.contains(kit::ViewChange::IntrinsicSize)) {
        mirrorBehavior(*view);
        gtk_widget_queue_resize(_content.get());
    }
    view->setScrollObserver(
        std::shared_ptr<kit::ScrollObserver>(shared_from_this(), static_cast<kit::ScrollObserver*>(this)));
}

void ScrollViewPeer::mirrorBehavior(const kit::ScrollView& view)
{
    const auto& behavior = view.scrollBehavior();
    const auto policy = [](bool shows) { return shows ? GTK_POLICY_AUTOMATIC : GTK_POLICY_EXTERNAL; };
    gtk_scrolled_window_set_policy(GTK_SCROLLED_WINDOW(native()), policy(behavior.showsHorizontalIndicator),
        policy(behavior.showsVerticalIndicator));
}

} // namespace host::gtk
