// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutItem.h"

#include "kit/layout/LayoutEngine.h"
#include "kit/values/Screen.h"

#include <algorithm>
#include <cmath>

namespace kit {

LayoutItem::LayoutItem() = default;

LayoutItem::~LayoutItem() = default;

bool LayoutItem::isInside(const LayoutItem& item) const
{
    if (this == &item)
        return true;
    const auto parent = layoutParent();
    return parent && parent->isInside(item);
}

LayoutItem& LayoutItem::layoutRoot()
{
    if (_layoutBoundary)
        return *this;
    const auto parent = layoutParent();
    return parent ? parent->layoutRoot() : *this;
}

LayoutEngine& LayoutItem::engine()
{
    if (!_engine)
        _engine = std::make_unique<LayoutEngine>(*this);
    return *_engine;
}

void LayoutItem::setLayoutBoundary(bool boundary)
{
    if (boundary == _layoutBoundary)
        return;
    _engine.reset();
    _layoutBoundary = boundary;
    layoutInputDidChange();
}

void LayoutItem::didJoinLayout()
{
    if (!_layoutBoundary)
        _engine.reset();
    markTreeForLayout();
}

void LayoutItem::layoutInputDidChange()
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->structureDidChange();
    markTreeForLayout();
}

void LayoutItem::directionDidChange()
{
    if (_engine)
        _engine->structureDidChange();
    setNeedsLayout();
}

void LayoutItem::frameDidChange(bool isAnotherSize)
{
    if (isAnotherSize) {
        if (_engine)
            _engine->frameDidChange(*this);
        setNeedsLayout();
    }
    if (auto& root = layoutRoot(); root._engine && &root != this)
        root._engine->frameDidChange(*this);
}

void LayoutItem::constraintConstantDidChange(const LayoutConstraint& constraint)
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->constantDidChange(constraint);
    markTreeForLayout();
}

void LayoutItem::invalidateIntrinsicContentSize()
{
    if (const auto& root = layoutRoot(); root._engine)
        root._engine->intrinsicSizeDidChange(*this);
    if (const auto parent = layoutParent())
        parent->_needsLayout = true;
    setNeedsLayout();
}

void LayoutItem::setNeedsLayout()
{
    _needsLayout = true;
    markTreeForLayout();
}

/// Tells every root above that something below it is stale. A root that already knows has told the roots
/// above it.
void LayoutItem::markTreeForLayout()
{
    const auto parent = layoutParent();
    if ((!parent || _layoutBoundary) && !_treeNeedsLayout) {
        _treeNeedsLayout = true;
        if (!_engine || !_engine->isRunning())
            layoutDidBecomeStale();
    }
    if (parent)
        parent->markTreeForLayout();
}

void LayoutItem::layoutIfNeeded()
{
    LayoutItem& root = layoutRoot();
    const auto keepAlive = root.layoutReference();
    if (root._treeNeedsLayout)
        root.engine().layout();
}

Size LayoutItem::systemLayoutSizeFitting(Size target)
{
    return LayoutEngine(*this).fittingSize(target);
}

void LayoutItem::deactivateConstraintsCrossing(const LayoutItem& part)
{
    layoutRoot().deactivateCrossingBelow(part);
}

void LayoutItem::deactivateCrossingBelow(const LayoutItem& part)
{
    const auto crosses = [&part](const std::shared_ptr<LayoutConstraint>& constraint) {
        const auto first = constraint->first().item(), second = constraint->second().item();
        return first && second && first->isInside(part) != second->isInside(part);
    };
    LayoutConstraints crossing;
    std::ranges::copy_if(_constraints, std::back_inserter(crossing), crosses);
    LayoutConstraint::deactivate(crossing);
    for (const auto& child : layoutChildren())
        child->deactivateCrossingBelow(part);
}

double LayoutItem::roundToPixel(double points)
{
    const double scale = Screen::mainScale();
    return std::floor(points * scale + 0.5) / scale;
}

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

} // namespace kit
