// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/ImageLoader.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewView.h"

#include <functional>

namespace screens {

/// A picture that fits its window at first and can be zoomed and moved.
class PreviewPictureView : public PreviewView {
public:
    static constexpr const char* kindName = "preview.picture";

    PreviewPictureView()
        : PreviewView(kindName)
    {
    }

    const Picture& picture() const { return _picture; }
    void setPicture(Picture picture);

    bool canZoom() const override { return true; }

    /// The callback runs when the picture is shown larger than its pixels and the file has more of them, once
    /// for each picture.
    void setOnNeedsPixels(std::function<void()> callback) { _onNeedsPixels = std::move(callback); }
    /// Event up: the peer shows the picture this many device pixels wide.
    void userSeesPixels(double width);

private:
    Picture _picture;
    bool _asked = false;
    std::function<void()> _onNeedsPixels;
};

} // namespace screens
