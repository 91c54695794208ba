// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/ImageView.h"

#include "kit/views/ViewVisitor.h"

namespace kit {

ImageView::ImageView(std::optional<Image> image)
    : _image(std::move(image))
{
}

void ImageView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void ImageView::setImage(std::optional<Image> image)
{
    if (image == _image)
        return;
    _image = std::move(image);
    invalidateIntrinsicContentSize();
    changed(ViewChange::Content);
}

void ImageView::setContentMode(ContentMode mode)
{
    if (mode == _contentMode)
        return;
    _contentMode = mode;
    changed(ViewChange::Content);
}

void ImageView::setMagnification(ImageFilter filter)
{
    if (filter == _magnification)
        return;
    _magnification = filter;
    changed(ViewChange::Content);
}

Size ImageView::intrinsicContentSize(double) const
{
    const bool hasSize = _image && (!_image->isNamed() || _image->size().width > 0);
    return hasSize ? _image->size() : Size{noIntrinsicMetric, noIntrinsicMetric};
}

} // namespace kit
