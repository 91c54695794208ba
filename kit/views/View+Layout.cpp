// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/views/View.h"

#include "kit/views/ViewOwner.h"

#include <algorithm>

namespace kit {

namespace {

double intrinsicSide(double wanted)
{
    return std::max(0.0, wanted);
}

} // namespace

std::shared_ptr<LayoutItem> View::layoutParent() const
{
    return superview();
}

std::vector<std::shared_ptr<LayoutItem>> View::layoutChildren() const
{
    return {_subviews.begin(), _subviews.end()};
}

std::shared_ptr<LayoutItem> View::layoutReference()
{
    return weak_from_this().lock();
}

LayoutAnchor View::anchor(LayoutAttribute attribute) const
{
    return {std::const_pointer_cast<View>(shared_from_this()), attribute};
}

void View::invalidateIntrinsicContentSize()
{
    LayoutItem::invalidateIntrinsicContentSize();
    changed(ViewChange::IntrinsicSize);
}

void View::layoutDidBecomeStale()
{
    changed(ViewChange::Layout);
}

void View::layOutContent()
{
    const auto owner = _owner.lock();
    if (owner)
        owner->viewWillLayoutSubviews();
    layoutSubviews();
    if (owner)
        owner->viewDidLayoutSubviews();
}

Size View::sizeThatFits(Size limit) const
{
    const Size wanted = intrinsicContentSize(limit.width);
    return {
        wanted.width < 0 ? _frame.width : wanted.width, wanted.height < 0 ? _frame.height : wanted.height};
}

void View::sizeToFit()
{
    const Size size = sizeThatFits({});
    setFrame({_frame.x, _frame.y, intrinsicSide(size.width), intrinsicSide(size.height)});
}

} // namespace kit
