// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutTranslation.h"

#include <algorithm>

namespace kit {

namespace {

bool isRelativeToDirection(LayoutAttribute attribute)
{
    return attribute == LayoutAttribute::Leading || attribute == LayoutAttribute::Trailing;
}

LayoutAttribute resolved(LayoutAttribute attribute, bool rightToLeft)
{
    if (attribute == LayoutAttribute::Leading)
        return rightToLeft ? LayoutAttribute::Right : LayoutAttribute::Left;
    if (attribute == LayoutAttribute::Trailing)
        return rightToLeft ? LayoutAttribute::Left : LayoutAttribute::Right;
    return attribute;
}

LayoutRelation mirrored(LayoutRelation relation)
{
    switch (relation) {
    case LayoutRelation::LessThanOrEqual:
        return LayoutRelation::GreaterThanOrEqual;
    case LayoutRelation::GreaterThanOrEqual:
        return LayoutRelation::LessThanOrEqual;
    case LayoutRelation::Equal:
        break;
    }
    return LayoutRelation::Equal;
}

} // namespace

bool LayoutRule::hasSameTerms(const LayoutRule& other) const
{
    return relation == other.relation
        && std::ranges::equal(terms, other.terms, [](const auto& a, const auto& b) {
               return a.variable == b.variable && a.coefficient == b.coefficient;
           });
}

LayoutTranslation::LayoutTranslation(const LayoutItem& root, const Variables& variables)
    : _root(root)
    , _variables(variables)
{
}

std::optional<LayoutRule> LayoutTranslation::translate(const LayoutConstraint& constraint)
{
    const auto first = constraint.first().item(), second = constraint.second().item();
    if (!first || !isInTree(*first) || (!constraint.second().isNone() && (!second || !isInTree(*second))))
        return std::nullopt;
    const bool rightToLeft = _root.isRightToLeft();
    // In a right-to-left layout, distances along the reading direction count from the right.
    const bool isMirrored = rightToLeft
        && (isRelativeToDirection(constraint.first().attribute())
            || isRelativeToDirection(constraint.second().attribute()));
    const auto space = commonSpace(constraint);
    LayoutRule rule;
    rule.relation = isMirrored ? mirrored(constraint.relation()) : constraint.relation();
    rule.constant = isMirrored ? -constraint.constant() : constraint.constant();
    add(rule, {first.get(), resolved(constraint.first().attribute(), rightToLeft), space.get()}, 1);
    if (second)
        add(rule, {second.get(), resolved(constraint.second().attribute(), rightToLeft), space.get()},
            -constraint.multiplier());
    return rule.terms.empty() ? std::nullopt : std::optional(std::move(rule));
}

bool LayoutTranslation::isInTree(const LayoutItem& item) const
{
    if (&item == &_root)
        return true;
    const auto above = item.layoutParent();
    return above && isInTree(*above);
}

/// Answers the nearest item around both sides. A constraint on one position alone is relative to the parent.
std::shared_ptr<LayoutItem> LayoutTranslation::commonSpace(const LayoutConstraint& constraint) const
{
    auto space = constraint.first().item();
    const auto second = constraint.second().item();
    if (!second)
        return space.get() == &_root ? space : space->layoutParent();
    while (space && !second->isInside(*space))
        space = space->layoutParent();
    return space;
}

const LayoutVariables* LayoutTranslation::variables(const LayoutItem& item) const
{
    const auto found = _variables.find(&item);
    return found == _variables.end() ? nullptr : &found->second;
}

void LayoutTranslation::add(LayoutRule& rule, const Side& side, double factor)
{
    switch (side.attribute) {
    case LayoutAttribute::Width:
        return addLength(rule, *side.item, Axis::Horizontal, factor);
    case LayoutAttribute::Height:
        return addLength(rule, *side.item, Axis::Vertical, factor);
    case LayoutAttribute::Left:
    case LayoutAttribute::Leading:
        return addPosition(rule, side, Axis::Horizontal, 0, factor);
    case LayoutAttribute::CenterX:
        return addPosition(rule, side, Axis::Horizontal, 0.5, factor);
    case LayoutAttribute::Right:
    case LayoutAttribute::Trailing:
        return addPosition(rule, side, Axis::Horizontal, 1, factor);
    case LayoutAttribute::Top:
        return addPosition(rule, side, Axis::Vertical, 0, factor);
    case LayoutAttribute::CenterY:
        return addPosition(rule, side, Axis::Vertical, 0.5, factor);
    case LayoutAttribute::Bottom:
        return addPosition(rule, side, Axis::Vertical, 1, factor);
    case LayoutAttribute::FirstBaseline:
        rule.constant -= factor * side.item->firstBaselineOffset();
        return addPosition(rule, side, Axis::Vertical, 0, factor);
    case LayoutAttribute::LastBaseline:
        rule.constant += factor * side.item->lastBaselineOffset();
        return addPosition(rule, side, Axis::Vertical, 1, factor);
    case LayoutAttribute::None:
        break;
    }
}

/// Adds the position of a line across the item, at a share of its length from its origin.
void LayoutTranslation::addPosition(
    LayoutRule& rule, const Side& side, Axis axis, double share, double factor)
{
    if (share != 0)
        addLength(rule, *side.item, axis, share * factor);
    std::shared_ptr<LayoutItem> parent;
    const auto* next = side.item;
    for (; next && next != side.space; parent = next->layoutParent(), next = parent.get()) {
        if (const auto* place = variables(*next)) {
            rule.terms.push_back({axis == Axis::Horizontal ? place->x : place->y, factor});
        } else {
            rule.constant -= factor * (axis == Axis::Horizontal ? next->frame().x : next->frame().y);
            _framesUsed.insert(next);
        }
    }
}

void LayoutTranslation::addLength(LayoutRule& rule, const LayoutItem& item, Axis axis, double factor)
{
    if (const auto* place = variables(item)) {
        rule.terms.push_back({axis == Axis::Horizontal ? place->width : place->height, factor});
        return;
    }
    rule.constant -= factor * (axis == Axis::Horizontal ? item.frame().width : item.frame().height);
    _framesUsed.insert(&item);
}

} // namespace kit
