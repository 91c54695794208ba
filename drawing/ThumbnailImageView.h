// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"
#include "platform/Image.h"

#include <memory>
#include <optional>

namespace kit {
class ImageView;
}

namespace tarrow {

class DRItem;

/// Shows an item's thumbnail, fitted into the view with a margin, or the icon of its type where it has none.
/// A thumbnail that must be read first appears when it is there. Main thread only.
class ThumbnailImageView : public kit::View {
public:
    using View::View;
    /// Makes a view without an item.
    static std::shared_ptr<ThumbnailImageView> initWithFrame(const platform::Rect& frame);

    const std::shared_ptr<DRItem>& item() const { return _item; }
    /// Shows an item. Null only forgets the item, and the image stays.
    void setItem(std::shared_ptr<DRItem> item);
    /// The only subview. It is placed by its frame, which it fills with the image.
    const std::shared_ptr<kit::ImageView>& thumbnailView() const { return _thumbnailView; }
    /// Answers whether the icon of the item's type is shown in place of a thumbnail.
    bool isGenericImage() const { return _isGenericImage; }
    void setIsGenericImage(bool generic) { _isGenericImage = generic; }

    void _setThumbnailImageWantsBorder(std::optional<platform::Image> image, bool wantsBorder);
    void showGenericImage();
    /// Answers the margin in points. A view with much room in both directions has a larger one.
    double margins() const;
    /// Answers the rectangle of the image, centred in `rect`. The image is as large as the rectangle without
    /// its margin allows, but enlarged at most 8 times; an icon is always shown at twice its size.
    /// `imageSize` is in points.
    platform::Rect aspectFitImageInRectWithMargins(
        platform::Size imageSize, const platform::Rect& rect, double margin) const;

    void layoutSubviews() override;

private:
    void showThumbnail();

    std::shared_ptr<DRItem> _item;
    std::shared_ptr<kit::ImageView> _thumbnailView;
    bool _isGenericImage = false;
};

} // namespace tarrow
