// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutConstraint.h"

#include "kit/layout/LayoutItem.h"
#include "kit/values/PlatformNames.h"
#include "platform/Log.h"

#include <algorithm>
#include <array>
#include <sstream>

namespace kit {

namespace {

std::string_view attributeName(LayoutAttribute attribute)
{
    static constexpr std::array<std::string_view, 13> names{"", "left", "right", "top", "bottom", "leading",
        "trailing", "width", "height", "centerX", "centerY", "firstBaseline", "lastBaseline"};
    return names[static_cast<std::size_t>(attribute)];
}

std::string anchorName(const LayoutAnchor& anchor)
{
    const auto item = anchor.item();
    std::string name = !item ? "(gone)" : item->debugName().empty() ? "view" : item->debugName();
    return name.append(".").append(attributeName(anchor.attribute()));
}

} // namespace

LayoutConstraint::LayoutConstraint(
    LayoutAnchor first, LayoutRelation relation, LayoutAnchor second, double multiplier, double constant)
    : _first(std::move(first))
    , _second(std::move(second))
    , _relation(relation)
    , _multiplier(multiplier)
    , _constant(constant)
{
}

void LayoutConstraint::setConstant(double constant)
{
    if (constant == _constant)
        return;
    _constant = constant;
    if (const auto item = _first.item(); item && _active)
        item->constraintConstantDidChange(*this);
}

void LayoutConstraint::setPriority(LayoutPriority priority)
{
    priority = std::clamp(priority, LayoutPriority{1}, LayoutPriorities::required);
    if (priority == _priority)
        return;
    _priority = priority;
    if (const auto item = _first.item(); item && _active)
        item->layoutInputDidChange();
}

std::shared_ptr<LayoutConstraint> LayoutConstraint::withPriority(LayoutPriority priority)
{
    setPriority(priority);
    return shared_from_this();
}

bool LayoutConstraint::setActive(bool active)
{
    static constexpr Operation op{"-[LayoutConstraint setActive:]"};
    if (active == _active)
        return true;
    const auto item = _first.item();
    _active = active && item;
    if (!item) {
        if (active)
            op.warning("No view to constrain: %{public}@", description());
        return !active;
    }
    if (active)
        item->_constraints.push_back(shared_from_this());
    else
        std::erase(item->_constraints, shared_from_this());
    item->layoutInputDidChange();
    return true;
}

std::string LayoutConstraint::description() const
{
    std::ostringstream text;
    text << anchorName(_first);
    text << (_relation == LayoutRelation::Equal            ? " = "
            : _relation == LayoutRelation::LessThanOrEqual ? " <= "
                                                           : " >= ");
    if (!_second.isNone())
        text << anchorName(_second) << " * " << _multiplier << " + ";
    text << _constant << " @" << _priority;
    return text.str();
}

void LayoutConstraint::activate(const LayoutConstraints& constraints)
{
    for (const auto& constraint : constraints)
        constraint->setActive(true);
}

void LayoutConstraint::deactivate(const LayoutConstraints& constraints)
{
    for (const auto& constraint : constraints)
        constraint->setActive(false);
}

} // namespace kit
