// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutAnchor.h"

#include <memory>
#include <string>
#include <vector>

namespace kit {

/// A relation: first = second * multiplier + constant (or <=, or >=). The item of its first anchor keeps an
/// active constraint alive. The constraint takes part in the layout while both items stand in one tree, and
/// ends when either item is destroyed. Taking an item out of a tree deactivates the constraints between it
/// and the rest of the tree. Main thread only.
class LayoutConstraint : public std::enable_shared_from_this<LayoutConstraint> {
public:
    /// Without a second anchor (`LayoutAnchor()`), the constraint compares the first anchor with the constant
    /// alone.
    LayoutConstraint(LayoutAnchor first, LayoutRelation relation, LayoutAnchor second, double multiplier = 1,
        double constant = 0);

    const LayoutAnchor& first() const { return _first; }
    const LayoutAnchor& second() const { return _second; }
    LayoutRelation relation() const { return _relation; }
    double multiplier() const { return _multiplier; }

    double constant() const { return _constant; }
    /// This is cheap, also for an active constraint, because the layout is adjusted and not built again.
    void setConstant(double constant);

    LayoutPriority priority() const { return _priority; }
    /// The priority is kept within 1 to 1000; 1000 means required.
    void setPriority(LayoutPriority priority);
    /// Sets the priority and answers the constraint itself, for chains such as
    /// `a.equalTo(b)->withPriority(999)`.
    std::shared_ptr<LayoutConstraint> withPriority(LayoutPriority priority);

    bool isActive() const { return _active; }
    /// Answers false, and logs a line, when the first item is gone.
    bool setActive(bool active);

    /// Answers the constraint in words, for the log.
    std::string description() const;

    static void activate(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);
    static void deactivate(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);

private:
    LayoutAnchor _first, _second;
    LayoutRelation _relation;
    double _multiplier, _constant;
    LayoutPriority _priority = LayoutPriorities::required;
    bool _active = false;
};

using LayoutConstraints = std::vector<std::shared_ptr<LayoutConstraint>>;

} // namespace kit
