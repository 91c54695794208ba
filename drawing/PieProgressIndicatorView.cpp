// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/PieProgressIndicatorView.h"

#include "kit/values/Canvas.h"
#include "kit/values/StandardColors.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace tarrow {

namespace {

/// The slice neither vanishes nor becomes the whole disc.
constexpr double leastProgress = 0.005, mostProgress = 0.995;
constexpr double fullTurn = 2 * std::numbers::pi, twelveOClock = -std::numbers::pi / 2;

} // namespace

std::shared_ptr<PieProgressIndicatorView> PieProgressIndicatorView::initWithFrame(const platform::Rect& frame)
{
    auto view = std::make_shared<PieProgressIndicatorView>(frame);
    view->setBackground(std::nullopt);
    return view;
}

void PieProgressIndicatorView::setProgress(float progress)
{
    if (progress == _progress)
        return;
    _progress = progress;
    setNeedsDisplay();
}

void PieProgressIndicatorView::drawRect(kit::Canvas& canvas) const
{
    const auto area = bounds();
    const double shown = std::clamp(static_cast<double>(_progress), leastProgress, mostProgress);
    canvas.setFillColor(kit::StandardColors::lightGray);
    canvas.setStrokeColor(kit::StandardColors::lightGray);
    canvas.fillPie({.center = {area.midX(), area.midY()},
        .radius = std::ceil(area.height / 2),
        .startAngle = twelveOClock,
        .endAngle = shown * fullTurn + twelveOClock});
    canvas.strokeEllipse(area);
}

} // namespace tarrow
