// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutAnchor.h"

#include <memory>
#include <string>
#include <vector>

namespace kit {

/// The relation: first = second * multiplier + constant (or <=, or >=). An active constraint is kept alive by
/// the view of its first anchor and takes part in the layout while both views stand in one tree; it ends with
/// either view. Taking a view out of a tree deactivates the constraints between it and what stays behind.
/// Main thread only.
class LayoutConstraint : public std::enable_shared_from_this<LayoutConstraint> {
public:
    /// Without a second anchor (`LayoutAnchor()`), the relation is to the constant alone.
    LayoutConstraint(LayoutAnchor first, LayoutRelation relation, LayoutAnchor second, double multiplier = 1,
        double constant = 0);

    const LayoutAnchor& first() const { return _first; }
    const LayoutAnchor& second() const { return _second; }
    LayoutRelation relation() const { return _relation; }
    double multiplier() const { return _multiplier; }

    double constant() const { return _constant; }
    /// Cheap, also while active: the layout is adjusted, not built again.
    void setConstant(double constant);

    LayoutPriority priority() const { return _priority; }
    /// Kept within 1 to 1000; 1000 is required.
    void setPriority(LayoutPriority priority);
    /// The same, to go on with the constraint: `a.equalTo(b)->withPriority(999)`.
    std::shared_ptr<LayoutConstraint> withPriority(LayoutPriority priority);

    bool isActive() const { return _active; }
    /// False, and a line in the log, when the first view is gone.
    bool setActive(bool active);

    const std::string& identifier() const { return _identifier; }
    void setIdentifier(std::string identifier) { _identifier = std::move(identifier); }
    /// The constraint in words, for the log.
    std::string description() const;

    static void activate(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);
    static void deactivate(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);

private:
    LayoutAnchor _first, _second;
    LayoutRelation _relation;
    double _multiplier, _constant;
    LayoutPriority _priority = LayoutPriorities::required;
    bool _active = false;
    std::string _identifier;
};

using LayoutConstraints = std::vector<std::shared_ptr<LayoutConstraint>>;

} // namespace kit
