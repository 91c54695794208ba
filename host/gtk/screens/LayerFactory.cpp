// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/LayerFactory.h"

#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/screens/AlertContent.h"
#include "host/gtk/screens/OverlayLayer.h"
#include "host/gtk/screens/PopoverLayer.h"
#include "host/gtk/screens/ScreenPeer.h"
#include "host/gtk/screens/SearchContent.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/ViewControllerVisitor.h"
#include "platform/Weakly.h"

#include <cmath>
#include <optional>

namespace host::gtk {

namespace {

constexpr int popoverWidth = 320, popoverHeight = 420; ///< points; the size of a screen in a popover
constexpr int widestPopover = 360; ///< points, with arrow and shadow

/// Shows a whole screen as the content of a layer.
class ScreenContent : public LayerContent {
public:
    ScreenContent(
        const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::ViewController>& screen)
        : _box(ObjectRef<GtkWidget>::retain(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))
        , _peer(makeScreenPeer(context, screen, WindowButtons::Hidden))
    {
        gtk_box_append(GTK_BOX(widget()), _peer->widget());
    }
    ~ScreenContent() override { gtk_box_remove(GTK_BOX(widget()), _peer->widget()); }

    GtkWidget* widget() const override { return _box.get(); }
    void focus() override { _peer->focus(); }

private:
    ObjectRef<GtkWidget> _box;
    std::shared_ptr<ScreenPeer> _peer;
};

std::optional<GdkRectangle> boundsIn(GtkWidget* canvas, GtkWidget* widget, std::optional<platform::Rect> part)
{
    graphene_rect_t bounds;
    if (!widget || !gtk_widget_compute_bounds(widget, canvas, &bounds))
        return std::nullopt;
    const auto& rect = part ? *part : platform::Rect{0, 0, bounds.size.width, bounds.size.height};
    const auto whole = [](double points) { return static_cast<int>(std::lround(points)); };
    return GdkRectangle{whole(bounds.origin.x + rect.x), whole(bounds.origin.y + rect.y),
        std::max(1, whole(rect.width)), std::max(1, whole(rect.height))};
}

/// Answers the rectangle of a view in the window. The view may only mark a place inside another view that is
/// shown.
std::optional<GdkRectangle> boundsIn(
    GtkWidget* canvas, const PeerContext& context, const kit::View& view, const platform::Rect& rect)
{
    auto shown = const_cast<kit::View&>(view).shared_from_this();
    const auto isShown = [&] {
        const auto* peer = context.peerOf(*shown);
        return peer && gtk_widget_get_mapped(peer->widget());
    };
    while (!isShown()) {
        shown = shown->superview();
        if (!shown)
            return std::nullopt;
    }
    return boundsIn(canvas, context.peerOf(*shown)->widget(), view.convertRect(rect, *shown));
}

/// Answers the place in the window at which a popover points, or nothing when there is no such place now.
std::optional<GdkRectangle> anchorOf(
    const PeerContext& context, GtkWidget* canvas, const kit::PopoverAnchor& anchor)
{
    if (const auto* item = std::get_if<std::weak_ptr<kit::BarButtonItem>>(&anchor)) {
        const auto shown = item->lock();
        return shown ? boundsIn(canvas, context.widgetOf(*shown), {}) : std::nullopt;
    }
    if (const auto* place = std::get_if<kit::ViewAnchor>(&anchor)) {
        const auto view = place->view.lock();
        return view ? boundsIn(canvas, context, *view, place->rect) : std::nullopt;
    }
    return std::nullopt;
}

/// Answers the side for a popover: beside the anchor when only such arrows are allowed and there is room,
/// else towards the window's middle.
GtkPositionType sideOf(const kit::PopoverAnchor& anchor, const GdkRectangle& place, platform::Size window)
{
    const auto* view = std::get_if<kit::ViewAnchor>(&anchor);
    if (view && view->arrows == kit::ArrowDirections::LeftOrRight) {
        if (window.width - place.x - place.width >= widestPopover)
            return GTK_POS_RIGHT;
        if (place.x >= widestPopover)
            return GTK_POS_LEFT;
    }
    return place.y + place.height / 2.0 > window.height / 2 ? GTK_POS_TOP : GTK_POS_BOTTOM;
}

class LayerMaker : public kit::ViewControllerVisitor {
public:
    LayerMaker(const std::shared_ptr<PeerContext>& context, const LayerSite& site)
        : _context(context)
        , _site(site)
    {
    }

    void visit(kit::ViewController& screen) override { makeScreen(screen); }
    void visit(kit::NavigationController& screen) override { makeScreen(screen); }
    void visit(kit::AlertController& screen) override
    {
        const auto alert = std::static_pointer_cast<kit::AlertController>(screen.shared_from_this());
        const auto content = [&] { return std::make_unique<AlertContent>(_context, alert); };
        if (screen.alertStyle() == kit::AlertStyle::Alert)
            makeOverlay(screen, content(), LayerPlace::Center);
        else if (const auto anchor = popoverAnchor(screen))
            makePopover(screen, content(), *anchor);
        else
            makeOverlay(screen, content(), isWide() ? LayerPlace::Center : LayerPlace::Bottom);
    }
    void visit(kit::SearchPresentation& screen) override
    {
        const auto search = std::static_pointer_cast<kit::SearchPresentation>(screen.shared_from_this());
        makeOverlay(screen, std::make_unique<SearchContent>(_context, search), LayerPlace::Cover);
    }

    std::unique_ptr<PresentedLayer> layer;

private:
    bool isWide() const { return _site.size.width >= wideWindow; }
    std::optional<GdkRectangle> popoverAnchor(const kit::ViewController& screen) const
    {
        return isWide() ? anchorOf(*_context, _site.canvas, screen.popoverAnchor()) : std::nullopt;
    }
    static std::function<void()> cancel(kit::ViewController& screen)
    {
        return platform::weakly(&screen, &kit::ViewController::userCancelled);
    }
    void makeScreen(kit::ViewController& screen)
    {
        auto content = std::make_unique<ScreenContent>(_context, screen.shared_from_this());
        const auto style = screen.presentationStyle();
        const auto anchor = style == kit::PresentationStyle::Popover ? popoverAnchor(screen) : std::nullopt;
        if (anchor) {
            gtk_widget_set_size_request(content->widget(), popoverWidth, popoverHeight);
            makePopover(screen, std::move(content), *anchor);
            return;
        }
        const bool fills = style == kit::PresentationStyle::FullScreen || !isWide();
        makeOverlay(screen, std::move(content), fills ? LayerPlace::Cover : LayerPlace::Sheet);
    }
    void makeOverlay(kit::ViewController& screen, std::unique_ptr<LayerContent> content, LayerPlace place)
    {
        layer = std::make_unique<OverlayLayer>(_site.overlay, std::move(content), place, cancel(screen));
    }
    void makePopover(
        kit::ViewController& screen, std::unique_ptr<LayerContent> content, const GdkRectangle& anchor)
    {
        const auto side = sideOf(screen.popoverAnchor(), anchor, _site.size);
        layer =
            std::make_unique<PopoverLayer>(_site.canvas, anchor, side, std::move(content), cancel(screen));
    }

    const std::shared_ptr<PeerContext>& _context;
    const LayerSite& _site;
};

} // namespace

std::unique_ptr<PresentedLayer> makeLayer(const std::shared_ptr<PeerContext>& context, const LayerSite& site,
    const std::shared_ptr<kit::ViewController>& screen)
{
    LayerMaker maker(context, site);
    screen->accept(maker);
    return std::move(maker.layer);
}

} // namespace host::gtk
