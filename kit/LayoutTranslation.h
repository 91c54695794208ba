// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/LayoutItem.h"
#include "kit/LayoutSolver.h"

#include <optional>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace platform::ui {

/// The place and size of a view in the solver; the origin is in the superview's coordinates.
struct LayoutVariables {
    LayoutSolver::Variable x, y, width, height;
};

/// A constraint as the solver takes it: sum of terms (relation) constant.
struct LayoutRule {
    std::vector<LayoutSolver::Term> terms;
    LayoutRelation relation = LayoutRelation::Equal;
    double constant = 0;

    bool hasSameTerms(const LayoutRule& other) const;
};

/// Turns constraints between the views of one tree into rules. The frame of a view without variables is a
/// number.
class LayoutTranslation {
public:
    using Variables = std::unordered_map<const View*, LayoutVariables>;

    LayoutTranslation(const View& root, const Variables& variables);

    /// Nothing when the views do not both stand in the tree, or when there is nothing to solve.
    std::optional<LayoutRule> translate(const LayoutConstraint& constraint);
    /// The views whose frames went into rules as numbers.
    const std::unordered_set<const View*>& framesUsed() const { return _framesUsed; }
    void forgetFramesUsed() { _framesUsed.clear(); }

private:
    struct Side {
        const View* view;
        LayoutAttribute attribute;
        const View* space; ///< in whose coordinates
    };
    std::shared_ptr<View> commonSpace(const LayoutConstraint& constraint) const;
    bool isInTree(const View& view) const;
    void add(LayoutRule& rule, const Side& side, double factor);
    void addPosition(LayoutRule& rule, const Side& side, Axis axis, double share, double factor);
    void addLength(LayoutRule& rule, const View& view, Axis axis, double factor);
    const LayoutVariables* variables(const View& view) const;

    const View& _root;
    const Variables& _variables;
    std::unordered_set<const View*> _framesUsed;
};

} // namespace platform::ui
