// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ThumbnailImageView.h"

#include "items/DRItem.h"
#include "kit/views/ImageView.h"
#include "platform/Weakly.h"
#include "screens/DocumentIcon.h"

#include <algorithm>
#include <limits>

namespace tarrow {

using kit::SizeClass;
using platform::Image;
using platform::Rect;
using platform::Size;
using platform::weakly;

namespace {

constexpr double roomyMargin = 45, usualMargin = 17; // points
constexpr double mostEnlarged = 8, iconScale = 2;
constexpr double borderWidth = 1;
constexpr platform::Color borderColor = platform::Color::gray(0, 0.16F);
/// A side that is smaller counts as none.
constexpr double leastSide = std::numeric_limits<float>::epsilon();

} // namespace

std::shared_ptr<ThumbnailImageView> ThumbnailImageView::initWithFrame(const Rect& frame)
{
    auto view = std::make_shared<ThumbnailImageView>(frame);
    view->_thumbnailView = std::make_shared<kit::ImageView>();
    view->_thumbnailView->setMagnification(kit::ImageFilter::Nearest);
    view->addSubview(view->_thumbnailView);
    return view;
}

void ThumbnailImageView::setItem(std::shared_ptr<DRItem> item)
{
    _item = std::move(item);
    if (_item)
        showThumbnail();
}

void ThumbnailImageView::showThumbnail()
{
    const auto& thumbnail = _item->thumbnail();
    _isGenericImage = !thumbnail || thumbnail->size().height < leastSide;
    if (!_isGenericImage)
        return _setThumbnailImageWantsBorder(thumbnail, true);
    showGenericImage();
    _item->whenThumbnailArrives(weakly(this, [asked = std::weak_ptr(_item)](ThumbnailImageView& self) {
        if (self._item == asked.lock())
            self.showThumbnail();
    }));
}

void ThumbnailImageView::_setThumbnailImageWantsBorder(std::optional<Image> image, bool wantsBorder)
{
    _thumbnailView->setImage(std::move(image));
    _thumbnailView->setBorder(wantsBorder ? borderWidth : 0, borderColor);
    setNeedsLayout();
}

void ThumbnailImageView::showGenericImage()
{
    if (!_item)
        return;
    const auto& place = _item->resolvedURL() ? *_item->resolvedURL() : _item->url();
    _setThumbnailImageWantsBorder(screens::documentIcon(_item->typeIdentifier(), place.lastPathComponent(),
                                      screens::DocumentIconFormat::Large),
        false);
}

double ThumbnailImageView::margins() const
{
    const auto& shown = traits();
    const bool hasRoom =
        shown.horizontalSizeClass == SizeClass::Regular && shown.verticalSizeClass == SizeClass::Regular;
    return hasRoom ? roomyMargin : usualMargin;
}

Rect ThumbnailImageView::aspectFitImageInRectWithMargins(
    Size imageSize, const Rect& rect, double margin) const
{
    double scale = 0;
    if (_isGenericImage)
        scale = iconScale;
    else if (imageSize.width >= leastSide && imageSize.height >= leastSide)
        scale = std::min({(rect.width - 2 * margin) / imageSize.width,
            (rect.height - 2 * margin) / imageSize.height, mostEnlarged});
    const Size shown{imageSize.width * scale, imageSize.height * scale};
    return {rect.x + (rect.width - shown.width) * 0.5, rect.y + (rect.height - shown.height) * 0.5,
        shown.width, shown.height};
}

void ThumbnailImageView::layoutSubviews()
{
    View::layoutSubviews();
    const auto& image = _thumbnailView->image();
    _thumbnailView->setFrame(
        aspectFitImageInRectWithMargins(image ? image->size() : Size(), bounds(), margins()));
}

} // namespace tarrow
