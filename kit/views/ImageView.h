// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "kit/views/View.h"
#include "platform/Image.h"

namespace kit {

enum class ContentMode { ScaleToFill, AspectFit, Center };
enum class ImageFilter { Smooth, Nearest };

/// Shows one image.
class ImageView : public View {
public:
    explicit ImageView(std::optional<Image> image = {});

    void accept(ViewVisitor& visitor) override;

    const std::optional<Image>& image() const { return _image; }
    void setImage(std::optional<Image> image);
    ContentMode contentMode() const { return _contentMode; }
    void setContentMode(ContentMode mode);
    /// Says how the image is enlarged; Nearest keeps hard pixel edges.
    ImageFilter magnification() const { return _magnification; }
    void setMagnification(ImageFilter filter);

    Size intrinsicContentSize(double maxWidth = 0) const override;

private:
    std::optional<Image> _image;
    ContentMode _contentMode = ContentMode::ScaleToFill;
    ImageFilter _magnification = ImageFilter::Smooth;
};

} // namespace kit
