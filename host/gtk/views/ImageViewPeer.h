// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class ImageView;
}

namespace host::gtk {

/// A GtkPicture for pixels, a GtkImage for an icon of the theme, the peer's own drawing where pixels are
/// enlarged without smoothing.
class ImageViewPeer : public ViewPeer {
public:
    ImageViewPeer(
        std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ImageView>& imageView);

    void canvasSnapshot(GtkSnapshot* snapshot) override;

protected:
    void mirror(kit::View& view, kit::ViewChanges changes) override;

private:
    enum class Means { None, Picture, Icon, Drawing };
    void mirrorImage(const kit::ImageView& imageView);
    void useMeans(Means means);

    std::weak_ptr<kit::ImageView> _imageView;
    Means _means = Means::None;
};

} // namespace host::gtk
