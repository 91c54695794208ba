// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/View.h"

#include <memory>

namespace tarrow {

/// Shows a share as a slice of a disc, clockwise from twelve o'clock. Main thread only.
class PieProgressIndicatorView : public kit::View {
public:
    using View::View;
    /// Makes a view with a transparent background.
    static std::shared_ptr<PieProgressIndicatorView> initWithFrame(const platform::Rect& frame);

    float progress() const { return _progress; } ///< 0 to 1; 0 at first
    void setProgress(float progress);

    bool drawsItself() const override { return true; }
    void drawRect(kit::Canvas& canvas) const override;

private:
    float _progress = 0;
};

} // namespace tarrow
