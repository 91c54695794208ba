// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutAnchor.h"

#include "kit/layout/LayoutConstraint.h"

namespace kit {

LayoutAnchor::LayoutAnchor(std::weak_ptr<LayoutItem> item, LayoutAttribute attribute)
    : _item(std::move(item))
    , _attribute(attribute)
{
}

LayoutAnchor::Made LayoutAnchor::equalTo(const LayoutAnchor& other, double constant, double multiplier) const
{
    return std::make_shared<LayoutConstraint>(*this, LayoutRelation::Equal, other, multiplier, constant);
}

LayoutAnchor::Made LayoutAnchor::lessThanOrEqualTo(
    const LayoutAnchor& other, double constant, double multiplier) const
{
    return std::make_shared<LayoutConstraint>(
        *this, LayoutRelation::LessThanOrEqual, other, multiplier, constant);
}

LayoutAnchor::Made LayoutAnchor::greaterThanOrEqualTo(
    const LayoutAnchor& other, double constant, double multiplier) const
{
    return std::make_shared<LayoutConstraint>(
        *this, LayoutRelation::GreaterThanOrEqual, other, multiplier, constant);
}

LayoutAnchor::Made LayoutAnchor::equalToConstant(double constant) const
{
    return equalTo({}, constant);
}

LayoutAnchor::Made LayoutAnchor::lessThanOrEqualToConstant(double constant) const
{
    return lessThanOrEqualTo({}, constant);
}

LayoutAnchor::Made LayoutAnchor::greaterThanOrEqualToConstant(double constant) const
{
    return greaterThanOrEqualTo({}, constant);
}

} // namespace kit
