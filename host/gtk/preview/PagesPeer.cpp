// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/preview/PagesPeer.h"

#include "host/gtk/base/ImagePaint.h"
#include "platform/Localization.h"

#include <cmath>
#include <limits>

namespace host::gtk {

using platform::Image;
using platform::Rect;
using platform::Size;
using screens::PreviewPagesView;

namespace {

/// The key of the detail's texture among those of the pages.
constexpr std::size_t detailKey = std::numeric_limits<std::size_t>::max();
constexpr GdkRGBA paper{1, 1, 1, 1};
constexpr GdkRGBA paperEdge{0, 0, 0, 0.25F};
constexpr GdkRGBA foundColor{1, 0.85F, 0, 0.4F};
constexpr GdkRGBA markedColor{1, 0.5F, 0, 0.55F};
constexpr GdkRGBA selectedColor{0.2F, 0.5F, 0.9F, 0.35F};
constexpr GdkRGBA fieldColor{0.2F, 0.5F, 0.9F, 0.14F};
constexpr GdkRGBA activeFieldColor{0.1F, 0.4F, 0.9F, 1};

graphene_rect_t toolkitRect(const Rect& rect)
{
    graphene_rect_t made;
    graphene_rect_init(&made, static_cast<float>(rect.x), static_cast<float>(rect.y),
        static_cast<float>(rect.width), static_cast<float>(rect.height));
    return made;
}

void fill(GtkSnapshot* snapshot, const Rect& rect, const GdkRGBA& color)
{
    const auto place = toolkitRect(rect);
    gtk_snapshot_append_color(snapshot, &color, &place);
}

} // namespace

PagesPeer::PagesPeer(const std::shared_ptr<PreviewPagesView>& view)
    : _view(view)
    , _scroller(*this, GTK_ACCESSIBLE_ROLE_DOCUMENT, ZoomScroller::Drag::IsForContent)
{
}

void PagesPeer::start()
{
    addShortcuts(widget(), _view);
    addSelection();
    addTap();
    addKeys();
    addUndo();
    _connections.push_back(
        connectSignal<void()>(widget(), "map", [this] { gtk_widget_grab_focus(_scroller.canvas()); }));
    const auto view = _view.lock();
    if (!view)
        return;
    // A view that was shown before returns to its place.
    const auto before = view->visiblePlace();
    previewZoomDidChange();
    if (before)
        _scroller.scrollTo(*before);
    updateLabel();
}

void PagesPeer::addSelection()
{
    auto* drag = gtk_gesture_drag_new();
    gtk_widget_add_controller(_scroller.canvas(), GTK_EVENT_CONTROLLER(drag));
    const auto isFinger = [drag] {
        auto* device = gtk_gesture_get_device(GTK_GESTURE(drag));
        return device && gdk_device_get_source(device) == GDK_SOURCE_TOUCHSCREEN;
    };
    _connections.push_back(
        connectSignal<void(double, double)>(drag, "drag-begin", [this](double x, double y) {
            _selectionStart = _scroller.toContent({x, y});
            _isHolding = false;
            if (const auto view = _view.lock())
                view->clearSelection();
        }));
    _connections.push_back(
        connectSignal<void(double, double)>(drag, "drag-update", [this, drag, isFinger](double x, double y) {
            const auto view = _view.lock();
            if (!view || (isFinger() && !_isHolding))
                return;
            double startX = 0, startY = 0;
            gtk_gesture_drag_get_start_point(GTK_GESTURE_DRAG(drag), &startX, &startY);
            view->userSelects(_selectionStart, _scroller.toContent({startX + x, startY + y}));
        }));
    auto* hold = gtk_gesture_long_press_new();
    gtk_gesture_single_set_touch_only(GTK_GESTURE_SINGLE(hold), TRUE);
    gtk_widget_add_controller(_scroller.canvas(), GTK_EVENT_CONTROLLER(hold));
    _connections.push_back(
        connectSignal<void(double, double)>(hold, "pressed", [this, drag](double x, double y) {
            constexpr double reach = 60; // points to both sides: about a word
            const auto at = _scroller.toContent({x, y});
            _isHolding = true;
            // From here on the finger selects instead of scrolling.
            gtk_gesture_set_state(GTK_GESTURE(drag), GTK_EVENT_SEQUENCE_CLAIMED);
            if (const auto view = _view.lock())
                view->userSelects({at.x - reach, at.y}, {at.x + reach, at.y});
        }));
}

/// Recognises a tap that does not move. A longer press selects instead.
void PagesPeer::addTap()
{
    auto* click = gtk_gesture_click_new();
    gtk_widget_add_controller(_scroller.canvas(), GTK_EVENT_CONTROLLER(click));
    _connections.push_back(
        connectSignal<void(int, double, double)>(click, "pressed", [this](int, double x, double y) {
            _pressed = {x, y};
        }));
    _connections.push_back(
        connectSignal<void(int, double, double)>(click, "released", [this](int, double x, double y) {
            constexpr double steady = 8; // points, also of a finger
            const auto view = _view.lock();
            if (view && !_isHolding && std::hypot(x - _pressed.x, y - _pressed.y) <= steady)
                view->userTaps(_scroller.toContent({x, y}));
        }));
}

/// Handles Ctrl+Z wherever the focus is, except in a text that is being written, which undoes its own edits.
void PagesPeer::addUndo()
{
    auto* controller = gtk_shortcut_controller_new();
    gtk_shortcut_controller_set_scope(GTK_SHORTCUT_CONTROLLER(controller), GTK_SHORTCUT_SCOPE_GLOBAL);
    const auto call = [](GtkWidget* shown, GVariant*, gpointer data) -> gboolean {
        auto* focus = gtk_root_get_focus(gtk_widget_get_root(shown));
        const auto view = static_cast<std::weak_ptr<View>*>(data)->lock();
        if (!view || !gtk_widget_get_mapped(shown) || GTK_IS_TEXT(focus) || GTK_IS_TEXT_VIEW(focus))
            return FALSE;
        view->userWantsUndo();
        return TRUE;
    };
    auto* action = gtk_callback_action_new(call, std::make_unique<std::weak_ptr<View>>(_view).release(),
        [](gpointer data) { delete static_cast<std::weak_ptr<View>*>(data); });
    gtk_shortcut_controller_add_shortcut(GTK_SHORTCUT_CONTROLLER(controller),
        gtk_shortcut_new(gtk_shortcut_trigger_parse_string("<Control>z"), action));
    gtk_widget_add_controller(widget(), controller);
}

void PagesPeer::addKeys()
{
    auto* keys = gtk_event_controller_key_new();
    gtk_widget_add_controller(_scroller.canvas(), keys);
    _connections.push_back(connectSignal<gboolean(guint, guint, GdkModifierType)>(
        keys, "key-pressed", [this](guint key, guint, GdkModifierType modifiers) -> gboolean {
            return pressed(key, (modifiers & GDK_CONTROL_MASK) != 0) ? TRUE : FALSE;
        }));
}

bool PagesPeer::pressed(guint key, bool withControl)
{
    const auto view = _view.lock();
    if (!view)
        return false;
    if (withControl && key == GDK_KEY_c)
        previewShouldCopy();
    else if (view->isPlacing() && (key == GDK_KEY_Return || key == GDK_KEY_KP_Enter))
        view->userPressesEnter();
    else
        return false;
    return true;
}

void PagesPeer::previewShouldCopy()
{
    const auto view = _view.lock();
    const auto text = view ? view->selectedText() : std::string();
    if (!text.empty())
        gdk_clipboard_set_text(gtk_widget_get_clipboard(widget()), text.c_str());
}

void PagesPeer::updateLabel()
{
    const auto view = _view.lock();
    if (!view || view->pageCount() == 0)
        return;
    const auto label = platform::localized("%1$@, page %2$d of %3$d",
        {view->accessibility().label, static_cast<std::int64_t>(view->currentPage() + 1),
            static_cast<std::int64_t>(view->pageCount())});
    gtk_accessible_update_property(
        GTK_ACCESSIBLE(_scroller.canvas()), GTK_ACCESSIBLE_PROPERTY_LABEL, label.c_str(), -1);
}

void PagesPeer::previewContentDidChange()
{
    _scroller.contentDidChange();
    updateLabel();
}

void PagesPeer::previewNeedsDisplay()
{
    const auto view = _view.lock();
    gtk_widget_set_cursor_from_name(_scroller.canvas(), view && view->isPlacing() ? "crosshair" : nullptr);
    gtk_widget_queue_draw(_scroller.canvas());
}

void PagesPeer::previewZoomDidChange()
{
    if (const auto view = _view.lock())
        _scroller.setZoom(view->zoom());
}

void PagesPeer::previewShouldScrollTo(const Rect& content)
{
    _scroller.scrollTo({content.x < _scroller.visible().x ? content.x : _scroller.visible().x, content.y});
}

void PagesPeer::previewShouldTakeFocus()
{
    gtk_widget_grab_focus(_scroller.canvas());
}

Size PagesPeer::baseSize(Size window)
{
    const auto view = _view.lock();
    if (!view)
        return {};
    view->userResized(window.width, gtk_widget_get_scale_factor(widget()));
    const auto size = view->deck().contentSize();
    const double zoom = view->deck().zoom();
    return {size.width / zoom, size.height / zoom};
}

void PagesPeer::zoomed(double zoom)
{
    if (const auto view = _view.lock())
        view->peerShowsZoom(zoom);
}

void PagesPeer::sees(const Rect& visible)
{
    const auto view = _view.lock();
    if (!view)
        return;
    const auto before = view->currentPage();
    view->userSees(visible);
    if (view->currentPage() != before)
        updateLabel();
}

void PagesPeer::draw(GtkSnapshot* snapshot, const Rect& visible)
{
    const auto view = _view.lock();
    if (!view || view->pageCount() == 0)
        return;
    const auto pages = view->deck().pagesIn(visible);
    std::erase_if(_shown, [&](const auto& entry) {
        return entry.first != detailKey && (entry.first + 1 < pages.first || entry.first > pages.end);
    });
    for (auto page = pages.first; page < pages.end; ++page)
        drawPage(snapshot, *view, page);
}

void PagesPeer::drawPage(GtkSnapshot* snapshot, const PreviewPagesView& view, std::size_t page)
{
    const auto& deck = view.deck();
    const auto frame = deck.pageFrame(page);
    fill(snapshot, {frame.x - 1, frame.y - 1, frame.width + 2, frame.height + 2}, paperEdge);
    fill(snapshot, frame, paper);
    if (const auto* picture = deck.picture(page))
        drawPicture(snapshot, page, *picture, frame);
    else if (deck.isBroken(page))
        drawBroken(snapshot, frame);
    if (const auto& detail = deck.detail(); detail && detail->task.page == page)
        drawPicture(snapshot, detailKey, detail->picture, deck.toContent(page, detail->task.part));
    drawMarks(snapshot, view, page);
}

void PagesPeer::drawPicture(GtkSnapshot* snapshot, std::size_t key, const Image& picture, const Rect& place)
{
    auto found = _shown.find(key);
    if (found == _shown.end() || !(found->second.picture == picture))
        found = _shown.insert_or_assign(key, Shown{picture, ImagePaint::texture(picture)}).first;
    const auto where = toolkitRect(place);
    gtk_snapshot_append_texture(snapshot, GDK_TEXTURE(found->second.texture.get()), &where);
}

void PagesPeer::drawMarks(GtkSnapshot* snapshot, const PreviewPagesView& view, std::size_t page)
{
    const auto& deck = view.deck();
    for (const auto& match : view.matchesOn(page))
        fill(snapshot, deck.toContent(page, match), foundColor);
    if (const auto marked = view.currentMatch(); marked && deck.pageAt(marked->midY()) == page)
        fill(snapshot, *marked, markedColor);
    drawFields(snapshot, view, page);
    const auto selected = view.selection().find(page);
    if (selected == view.selection().end())
        return;
    for (const auto& place : selected->second.places)
        fill(snapshot, deck.toContent(page, place), selectedColor);
}

void PagesPeer::drawFields(GtkSnapshot* snapshot, const PreviewPagesView& view, std::size_t page)
{
    const auto* active = view.activeField();
    for (const auto& field : view.fields()) {
        if (field.page != page)
            continue;
        const auto place = view.deck().toContent(page, field.place);
        fill(snapshot, place, fieldColor);
        if (&field != active)
            continue;
        GskRoundedRect outline;
        const auto frame = toolkitRect({place.x - 2, place.y - 2, place.width + 4, place.height + 4});
        gsk_rounded_rect_init_from_rect(&outline, &frame, 2);
        constexpr float widths[] = {2, 2, 2, 2};
        const GdkRGBA colors[] = {activeFieldColor, activeFieldColor, activeFieldColor, activeFieldColor};
        gtk_snapshot_append_border(snapshot, &outline, widths, colors);
    }
}

void PagesPeer::drawBroken(GtkSnapshot* snapshot, const Rect& frame)
{
    constexpr GdkRGBA ink{0.35F, 0.35F, 0.35F, 1};
    constexpr double margin = 16;
    const auto words = platform::localized("This page cannot be shown.");
    const auto layout =
        ObjectRef<PangoLayout>::adopt(gtk_widget_create_pango_layout(_scroller.canvas(), words.c_str()));
    pango_layout_set_width(layout.get(), static_cast<int>((frame.width - 2 * margin) * PANGO_SCALE));
    pango_layout_set_alignment(layout.get(), PANGO_ALIGN_CENTER);
    graphene_point_t place;
    graphene_point_init(
        &place, static_cast<float>(frame.x + margin), static_cast<float>(frame.y + frame.height / 3));
    gtk_snapshot_save(snapshot);
    gtk_snapshot_translate(snapshot, &place);
    gtk_snapshot_append_layout(snapshot, layout.get(), &ink);
    gtk_snapshot_restore(snapshot);
}

} // namespace host::gtk
