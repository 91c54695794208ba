// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/LayoutItem.h"

namespace platform::ui {

void LayoutItem::setPlacedByFrame(bool placedByFrame)
{
    if (placedByFrame == _placedByFrame)
        return;
    _placedByFrame = placedByFrame;
    layoutInputDidChange();
}

void LayoutItem::setHugging(LayoutPriority priority, Axis axis)
{
    _hugging[static_cast<std::size_t>(axis)] = priority;
    layoutInputDidChange();
}

void LayoutItem::setCompressionResistance(LayoutPriority priority, Axis axis)
{
    _resistance[static_cast<std::size_t>(axis)] = priority;
    layoutInputDidChange();
}

Size LayoutItem::intrinsicContentSize(double) const
{
    return {noIntrinsicMetric, noIntrinsicMetric};
}

double LayoutItem::firstBaselineOffset() const
{
    return 0;
}

void LayoutItem::setNeedsUpdateConstraints()
{
    _needsUpdateConstraints = true;
    layoutInputDidChange();
}

} // namespace platform::ui
