// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutItem.h"
#include "kit/layout/LayoutSolver.h"

#include <optional>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace kit {

/// The place and the size of an item in the solver. The origin is in the parent's coordinates.
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

/// Turns constraints between the items of one tree into rules. The frame of an item that has no variables
/// enters a rule as a number.
class LayoutTranslation {
public:
    using Variables = std::unordered_map<const LayoutItem*, LayoutVariables>;

    LayoutTranslation(const LayoutItem& root, const Variables& variables);

    /// Answers nothing when one of the items is not in the tree, or when the rule has no variable.
    std::optional<LayoutRule> translate(const LayoutConstraint& constraint);
    /// The items whose frames went into rules as numbers.
    const std::unordered_set<const LayoutItem*>& framesUsed() const { return _framesUsed; }
    void forgetFramesUsed() { _framesUsed.clear(); }

private:
    struct Side {
        const LayoutItem* item;
        LayoutAttribute attribute;
        const LayoutItem* space; ///< the item in whose coordinates the side is meant
    };
    std::shared_ptr<LayoutItem> commonSpace(const LayoutConstraint& constraint) const;
    bool isInTree(const LayoutItem& item) const;
    void add(LayoutRule& rule, const Side& side, double factor);
    void addPosition(LayoutRule& rule, const Side& side, Axis axis, double share, double factor);
    void addLength(LayoutRule& rule, const LayoutItem& item, Axis axis, double factor);
    const LayoutVariables* variables(const LayoutItem& item) const;

    const LayoutItem& _root;
    const Variables& _variables;
    std::unordered_set<const LayoutItem*> _framesUsed;
};

} // namespace kit
