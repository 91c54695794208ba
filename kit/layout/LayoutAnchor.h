// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace kit {

class LayoutConstraint;
class LayoutItem;

enum class LayoutAttribute {
    None,
    Left,
    Right,
    Top,
    Bottom,
    Leading, ///< left in a left-to-right layout, right in a right-to-left one
    Trailing,
    Width,
    Height,
    CenterX,
    CenterY,
    FirstBaseline,
    LastBaseline,
};

enum class LayoutRelation { LessThanOrEqual, Equal, GreaterThanOrEqual };

/// Priorities of constraints, 1 to 1000. A constraint is never missed for the sake of one with a lower
/// priority.
using LayoutPriority = float;

namespace LayoutPriorities {

inline constexpr LayoutPriority required = 1000;
inline constexpr LayoutPriority defaultHigh = 750; ///< resistance against being made smaller than the content
inline constexpr LayoutPriority defaultLow = 250; ///< hugging: resistance against being made larger
inline constexpr LayoutPriority fittingSize =
    50; ///< the pull to the smallest size when a fitting size is asked

} // namespace LayoutPriorities

/// One edge, centre line, dimension or baseline of an item. Its builders answer a new constraint that is not
/// active yet: this anchor = (other anchor * multiplier) + constant.
class LayoutAnchor {
public:
    LayoutAnchor() = default;
    LayoutAnchor(std::weak_ptr<LayoutItem> item, LayoutAttribute attribute);

    std::shared_ptr<LayoutItem> item() const { return _item.lock(); }
    LayoutAttribute attribute() const { return _attribute; }
    bool isNone() const { return _attribute == LayoutAttribute::None; }

    using Made = std::shared_ptr<LayoutConstraint>;
    Made equalTo(const LayoutAnchor& other, double constant = 0, double multiplier = 1) const;
    Made lessThanOrEqualTo(const LayoutAnchor& other, double constant = 0, double multiplier = 1) const;
    Made greaterThanOrEqualTo(const LayoutAnchor& other, double constant = 0, double multiplier = 1) const;

    /// Anchors of widths and heights take a plain number of points.
    Made equalToConstant(double constant) const;
    Made lessThanOrEqualToConstant(double constant) const;
    Made greaterThanOrEqualToConstant(double constant) const;

private:
    std::weak_ptr<LayoutItem> _item;
    LayoutAttribute _attribute = LayoutAttribute::None;
};

} // namespace kit
