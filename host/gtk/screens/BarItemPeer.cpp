// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/screens/BarItemPeer.h"

#include "host/gtk/base/ImagePaint.h"
#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/views/ButtonPeer.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"

#include <algorithm>
#include <utility>

namespace host::gtk {
using platform::Size;
using platform::weakly;
using platform::weaklyOr;

namespace {

constexpr int iconSize = 16;
constexpr double barHeight = 44; ///< points; the height of an item's own view

const char* iconOf(kit::SystemItem item)
{
    switch (item) {
    case kit::SystemItem::Action:
        return "emblem-shared-symbolic";
    case kit::SystemItem::Trash:
        return "user-trash-symbolic";
    case kit::SystemItem::Organize:
        return "folder-symbolic";
    case kit::SystemItem::Search:
        return "system-search-symbolic";
    default:
        return nullptr;
    }
}

/// Answers the name of an item. The kit names standard items in English; the name is translated here.
std::string nameOf(const kit::BarButtonItem& item)
{
    const auto& name = item.accessibilityLabel();
    return item.systemItem() == kit::SystemItem::Plain ? name : platform::localized(name);
}

std::optional<platform::Image> imageOf(const kit::BarButtonItem& item, bool isNarrow)
{
    if (isNarrow && item.compactImage())
        return item.compactImage();
    if (item.image())
        return item.image();
    const char* icon = iconOf(item.systemItem());
    return icon ? std::optional(platform::Image::named(icon)) : std::nullopt;
}

} // namespace

std::shared_ptr<ViewPeer> makeEmbeddedPeer(
    const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::View>& view, double minimumHeight)
{
    auto peer = makePeer(context, view);
    const auto resize = weakly(view, [](kit::View& shown, Size size) {
        shown.setFrame({0, 0, size.width, size.height});
    });
    const auto fit = weaklyOr(Size(), view, [minimumHeight](kit::View& shown, double forWidth) {
        const Size wanted = shown.intrinsicContentSize(std::max(0.0, forWidth));
        return Size{wanted.width, std::max(wanted.height, minimumHeight)};
    });
    peer->setRoot(resize, fit);
    return peer;
}

std::shared_ptr<BarItemPeer> BarItemPeer::make(
    const std::shared_ptr<PeerContext>& context, const std::shared_ptr<kit::BarButtonItem>& item)
{
    auto peer = std::make_shared<BarItemPeer>(context, item);
    item->setObserver(peer);
    return peer;
}

BarItemPeer::BarItemPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::BarButtonItem>& item)
    : _context(std::move(context))
    , _item(item)
    , _key(item.get())
{
    if (item->customView())
        showCustomView(item->customView());
    else
        showButton();
    _context->setWidget(*item, widget());
    mirror(*item);
}

BarItemPeer::~BarItemPeer()
{
    _context->scheduler().cancel(this);
    _context->removeWidget(*_key, widget());
}

void BarItemPeer::showCustomView(const std::shared_ptr<kit::View>& view)
{
    _customPeer = makeEmbeddedPeer(_context, view, barHeight);
    _widget = ObjectRef<GtkWidget>::retain(_customPeer->widget());
    // A view without a width of its own takes the space that the bar has left.
    const bool wantsAll = view->intrinsicContentSize().width <= 0;
    gtk_widget_set_hexpand(widget(), wantsAll);
    gtk_widget_set_valign(widget(), GTK_ALIGN_FILL);
}

void BarItemPeer::showButton()
{
    _widget = ObjectRef<GtkWidget>::retain(makeTouchButton());
    gtk_widget_set_valign(widget(), GTK_ALIGN_CENTER);
    _onClicked = connectSignal<void()>(widget(), "clicked", weakly(_item, &kit::BarButtonItem::press));
}

void BarItemPeer::barButtonItemDidChange(kit::BarButtonItem&)
{
    _context->scheduler().schedule(this, [this] {
        if (const auto changed = item())
            mirror(*changed);
    });
}

void BarItemPeer::setNarrow(bool narrow)
{
    const auto shown = item();
    if (narrow == std::exchange(_isNarrow, narrow) || !shown)
        return;
    mirror(*shown);
}

void BarItemPeer::showFace(const kit::BarButtonItem& shown)
{
    auto* button = GTK_BUTTON(widget());
    const auto image = imageOf(shown, _isNarrow);
    if (image) {
        auto* icon = gtk_image_new();
        ImagePaint::show(GTK_IMAGE(icon), *image, iconSize);
        gtk_button_set_child(button, icon);
    } else {
        const auto title = shown.title().empty() ? nameOf(shown) : shown.title();
        gtk_button_set_label(button, title.c_str());
    }
    gtk_widget_remove_css_class(widget(), image ? "text-button" : "image-button");
    gtk_widget_add_css_class(widget(), image ? "image-button" : "text-button");
    gtk_widget_set_tooltip_text(widget(), image ? nameOf(shown).c_str() : nullptr);
}

void BarItemPeer::mirror(const kit::BarButtonItem& shown)
{
    if (_customPeer)
        return;
    showFace(shown);
    if (shown.systemItem() == kit::SystemItem::Done)
        gtk_widget_add_css_class(widget(), "suggested-action");
    gtk_widget_set_sensitive(widget(), shown.isEnabled());
    gtk_accessible_update_property(
        GTK_ACCESSIBLE(widget()), GTK_ACCESSIBLE_PROPERTY_LABEL, nameOf(shown).c_str(), -1);
}

} // namespace host::gtk
