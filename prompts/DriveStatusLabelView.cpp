// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/DriveStatusLabelView.h"

#include "kit/views/Label.h"
#include "screens/StorageUpgradeButton.h"

#include <algorithm>

namespace tarrow {

using platform::Rect;
using platform::Size;

namespace {

constexpr double gapToLabelHeight = 0.25;
/// The line stands this much above the middle (points), which looks centred above a toolbar's lower edge.
constexpr double lift = 1.0;

Rect fittedFrame(kit::View* view)
{
    if (!view)
        return {};
    view->sizeToFit();
    return view->frame();
}

Rect placed(Rect frame, double x, double y)
{
    frame.x = kit::View::roundToPixel(x);
    frame.y = kit::View::roundToPixel(y);
    return frame;
}

} // namespace

/// The size of both views together: the line, and the button's title one gap below it.
struct DriveStatusLabelView::Block {
    double gap = 0, height = 0;
};

std::shared_ptr<DriveStatusLabelView> DriveStatusLabelView::initWithFrame(const Rect& frame)
{
    return std::make_shared<DriveStatusLabelView>(frame);
}

DriveStatusLabelView::DriveStatusLabelView(const Rect& frame)
    : View(frame)
{
    setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
}

void DriveStatusLabelView::setQuotaButton(std::shared_ptr<screens::StorageUpgradeButton> button)
{
    _quotaButton = std::move(button);
}

void DriveStatusLabelView::setPrimaryLabelText(const std::string& text)
{
    if (!_primaryLabel)
        return;
    _primaryLabel->setText(text);
    _primaryLabel->sizeToFit();
    invalidateIntrinsicContentSize();
    setNeedsLayout();
}

void DriveStatusLabelView::showLowQuota(bool show)
{
    setShowLowQuota(show);
    if (_quotaButton)
        _quotaButton->setHidden(!show);
    invalidateIntrinsicContentSize();
    setNeedsLayout();
}

double DriveStatusLabelView::titleHeight(double labelHeight) const
{
    if (!_quotaButton)
        return labelHeight;
    _quotaButton->layoutSubviews();
    const double height = _quotaButton->titleLabel()->frame().height;
    return height < 1.0 ? labelHeight : height;
}

DriveStatusLabelView::Block DriveStatusLabelView::block(double labelHeight, double title) const
{
    const double line = _primaryLabel && !_primaryLabel->text().empty() ? labelHeight : 0;
    if (!_showLowQuota)
        return {0, line};
    const double gap = labelHeight * gapToLabelHeight;
    return {gap, gap + title + line};
}

void DriveStatusLabelView::layoutSubviews()
{
    auto label = fittedFrame(_primaryLabel.get());
    auto button = fittedFrame(_quotaButton.get());
    const double title = titleHeight(label.height);
    if (button.height < 1.0)
        button = label;
    const auto [gap, height] = block(label.height, title);
    const auto area = bounds();
    label = placed(label, (area.width - label.width) * 0.5, (area.height - height) * 0.5 - lift);
    button =
        placed(button, (area.width - button.width) * 0.5, label.maxY() + gap - (button.height - title) * 0.5);
    if (_primaryLabel)
        _primaryLabel->setFrame(label);
    if (_quotaButton)
        _quotaButton->setFrame(button);
}

Size DriveStatusLabelView::intrinsicContentSize(double) const
{
    const auto label = _primaryLabel ? _primaryLabel->sizeThatFits({}) : Size{};
    if (!_showLowQuota || !_quotaButton)
        return {label.width, label.height + 2 * lift};
    const auto button = _quotaButton->sizeThatFits({});
    // The button's frame is higher than its title. The whole frame counts below the line, so that nothing is
    // cut off.
    return {std::max(label.width, button.width),
        label.height * (1 + gapToLabelHeight) + button.height + 2 * lift};
}

} // namespace tarrow
