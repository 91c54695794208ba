// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/View.h"

#include "kit/LayoutEngine.h"

#include <algorithm>
#include <cmath>

namespace platform::ui {

namespace {

double intrinsicSide(double wanted)
{
    return std::max(0.0, wanted);
}

} // namespace

View& View::layoutRoot()
{
    if (_layoutBoundary)
        return *this;
    const auto above = superview();
    return above ? above->layoutRoot() : *this;
}

LayoutEngine& View::engine()
{
    if (!_engine)
        _engine = std::make_unique<LayoutEngine>(*this);
    return *_engine;
}

void View::setLayoutBoundary(bool boundary)
{
    if (boundary == _layoutBoundary)
        return;
    _engine.reset();
    _layoutBoundary = boundary;
    layoutInputDidChange();
}

LayoutAnchor View::anchor(LayoutAttribute attribute) const
{
    return {std::const_pointer_cast<View>(shared_from_this()), attribute};
}

void View::layoutInputDidChange()
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->structureDidChange();
    markTreeForLayout();
}

void View::constraintConstantDidChange(const LayoutConstraint& constraint)
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->constantDidChange(constraint);
    markTreeForLayout();
}

void View::invalidateIntrinsicContentSize()
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->intrinsicSizeDidChange(*this);
    if (const auto above = superview())
        above->_needsLayout = true;
    setNeedsLayout();
    changed(ViewChange::IntrinsicSize);
}

void View::setNeedsLayout()
{
    _needsLayout = true;
    markTreeForLayout();
}

/// Lets every root above know that something below is stale; a root that knows already has told its observer.
void View::markTreeForLayout()
{
    const auto above = superview();
    if ((!above || _layoutBoundary) && !_treeNeedsLayout) {
        _treeNeedsLayout = true;
        if (!_engine || !_engine->isRunning())
            changed(ViewChange::Layout);
    }
    if (above)
        above->markTreeForLayout();
}

void View::layoutIfNeeded()
{
    View& root = layoutRoot();
    const auto keepAlive = root.weak_from_this().lock();
    if (root._treeNeedsLayout)
        root.engine().layout();
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

Size View::systemLayoutSizeFitting(Size target)
{
    return LayoutEngine(*this).fittingSize(target);
}

} // namespace platform::ui
