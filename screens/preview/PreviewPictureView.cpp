// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewPictureView.h"

#include <utility>

namespace screens {

void PreviewPictureView::setPicture(Picture picture)
{
    _picture = std::move(picture);
    _asked = false;
    peer().notify([](auto& peer) { peer.previewContentDidChange(); });
}

void PreviewPictureView::userSeesPixels(double width)
{
    const int decoded = _picture.frames.empty() ? 0 : _picture.frames.front().image.pixelWidth();
    // A picture that is only a little larger than its pixels looks no different.
    constexpr double tolerance = 1.2;
    if (_asked || _picture.sourceWidth <= decoded || width <= decoded * tolerance)
        return;
    _asked = true;
    if (const auto call = _onNeedsPixels)
        call();
}

} // namespace screens
