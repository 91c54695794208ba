// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"

namespace kit {
class ImageView;
}

namespace host::gtk {

/// Shows pixels with a GtkPicture and an icon of the theme with a GtkImage. Pixels that are enlarged without
/// smoothing are drawn by the peer itself.
class ImageViewPeer : public ViewPeer {
public:
    ImageViewPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::ImageView>& imageView);

protected:
    void snapshotDrawing(const kit::View& shown, GtkSnapshot* snapshot) override;
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    enum class Means { None, Picture, Icon, Drawing };
    void mirrorImage(const kit::ImageView& imageView);
    void useMeans(Means means);

    std::weak_ptr<kit::ImageView> _imageView;
    Means _means = Means::None;
};

} // namespace host::gtk
