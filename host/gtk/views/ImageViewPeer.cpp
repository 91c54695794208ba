// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/views/ImageViewPeer.h"

#include "host/gtk/base/ImagePaint.h"
#include "kit/views/ImageView.h"

#include <algorithm>

namespace host::gtk {
using platform::Rect;

namespace {

GtkContentFit fit(kit::ContentMode mode)
{
    switch (mode) {
    case kit::ContentMode::ScaleToFill:
        return GTK_CONTENT_FIT_FILL;
    case kit::ContentMode::AspectFit:
        return GTK_CONTENT_FIT_CONTAIN;
    case kit::ContentMode::Center:
        return GTK_CONTENT_FIT_SCALE_DOWN;
    }
    return GTK_CONTENT_FIT_CONTAIN;
}

Rect placed(const kit::ImageView& view, double width, double height)
{
    const auto size = view.image()->size();
    if (view.contentMode() == kit::ContentMode::ScaleToFill || size.width <= 0 || size.height <= 0)
        return {0, 0, width, height};
    double factor = std::min(width / size.width, height / size.height);
    if (view.contentMode() == kit::ContentMode::Center)
        factor = std::min(factor, 1.0);
    const double shownWidth = size.width * factor, shownHeight = size.height * factor;
    return {(width - shownWidth) / 2, (height - shownHeight) / 2, shownWidth, shownHeight};
}

GtkWidget* silent(GType type)
{
    return GTK_WIDGET(g_object_new(type, "accessible-role", GTK_ACCESSIBLE_ROLE_PRESENTATION, nullptr));
}

} // namespace

ImageViewPeer::ImageViewPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ImageView>& imageView)
    : ViewPeer(std::move(context), imageView,
        imageView->accessibility().label.empty() ? GTK_ACCESSIBLE_ROLE_GROUP : GTK_ACCESSIBLE_ROLE_IMG)
    , _imageView(imageView)
{
}

void ImageViewPeer::mirror(kit::View& shown, kit::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto imageView = _imageView.lock();
    if (imageView
        && (changes.contains(kit::ViewChange::Content)
            || (_means == Means::Icon && changes.contains(kit::ViewChange::Frame))))
        mirrorImage(*imageView);
}

void ImageViewPeer::mirrorImage(const kit::ImageView& imageView)
{
    const auto& image = imageView.image();
    if (!image) {
        useMeans(Means::None);
    } else if (image->isNamed()) {
        useMeans(Means::Icon);
        const auto& frame = imageView.frame();
        ImagePaint::show(
            GTK_IMAGE(native()), *image, std::max(1, static_cast<int>(std::min(frame.width, frame.height))));
    } else if (imageView.magnification() == kit::ImageFilter::Nearest) {
        useMeans(Means::Drawing);
    } else {
        useMeans(Means::Picture);
        gtk_picture_set_content_fit(GTK_PICTURE(native()), fit(imageView.contentMode()));
        gtk_picture_set_paintable(GTK_PICTURE(native()), ImagePaint::texture(*image).get());
    }
    gtk_widget_queue_draw(widget());
}

void ImageViewPeer::useMeans(Means means)
{
    if (means == _means)
        return;
    _means = means;
    GtkWidget* made = nullptr;
    if (means == Means::Picture) {
        made = silent(GTK_TYPE_PICTURE);
        gtk_picture_set_can_shrink(GTK_PICTURE(made), TRUE);
    } else if (means == Means::Icon) {
        made = silent(GTK_TYPE_IMAGE);
    }
    setNative(made);
    gtk_widget_queue_allocate(widget());
}

/// Hard edges are for enlarged pixels; a picture that is made smaller would lose lines.
void ImageViewPeer::snapshotDrawing(const kit::View& shown, GtkSnapshot* snapshot)
{
    ViewPeer::snapshotDrawing(shown, snapshot);
    const auto imageView = _imageView.lock();
    if (_means != Means::Drawing || !imageView || !imageView->image())
        return;
    const double width = gtk_widget_get_width(widget()), height = gtk_widget_get_height(widget());
    graphene_rect_t bounds;
    graphene_rect_init(&bounds, 0, 0, static_cast<float>(width), static_cast<float>(height));
    auto* cairo = gtk_snapshot_append_cairo(snapshot, &bounds);
    const auto place = placed(*imageView, width, height);
    const bool isEnlarged =
        place.width * gtk_widget_get_scale_factor(widget()) > imageView->image()->pixelWidth();
    ImagePaint::draw(
        cairo, *imageView->image(), place, isEnlarged ? CAIRO_FILTER_NEAREST : CAIRO_FILTER_GOOD);
    cairo_destroy(cairo);
}

} // namespace host::gtk
