// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/ScrollView.h"

#include "kit/views/ViewVisitor.h"

#include <algorithm>

namespace kit {

void ScrollView::accept(ViewVisitor& visitor)
{
    visitor.visit(*this);
}

void ScrollView::setContentSize(Size size)
{
    if (size == _contentSize)
        return;
    _contentSize = size;
    _scrollObserver.notify([this](ScrollObserver& observer) { observer.scrollExtentDidChange(*this); });
}

void ScrollView::setContentInsets(const EdgeInsets& insets)
{
    if (insets == _contentInsets)
        return;
    _contentInsets = insets;
    _scrollObserver.notify([this](ScrollObserver& observer) { observer.scrollExtentDidChange(*this); });
}

void ScrollView::setScrollBehavior(const ScrollBehavior& behavior)
{
    if (behavior == _behavior)
        return;
    _behavior = behavior;
    _scrollObserver.notify([this](ScrollObserver& observer) { observer.scrollExtentDidChange(*this); });
}

void ScrollView::setContentOffset(Point offset, bool animated)
{
    if (offset == contentOffset())
        return;
    setBoundsOrigin(offset);
    _scrollObserver.notify([&](ScrollObserver& observer) { observer.scrollTo(*this, offset, animated); });
    contentOffsetDidChange();
}

void ScrollView::scrollRectToVisible(const Rect& rect, bool animated)
{
    const auto nearest = [](double offset, double visible, double start, double length) {
        if (start < offset || length > visible)
            return start;
        return std::max(offset, start + length - visible);
    };
    const double width = bounds().width - _contentInsets.left - _contentInsets.right;
    const double height = bounds().height - _contentInsets.top - _contentInsets.bottom;
    const double x = nearest(contentOffset().x + _contentInsets.left, width, rect.x, rect.width);
    const double y = nearest(contentOffset().y + _contentInsets.top, height, rect.y, rect.height);
    setContentOffset({x - _contentInsets.left, y - _contentInsets.top}, animated);
}

void ScrollView::userScrolled(Point offset)
{
    if (offset == contentOffset())
        return;
    setBoundsOrigin(offset);
    contentOffsetDidChange();
}

} // namespace kit
