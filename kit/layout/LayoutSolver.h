// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutAnchor.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <vector>

namespace kit {

/// Solves systems of linear equations and inequalities over real numbers, incrementally, by the Cassowary
/// method (a simplex tableau that is kept solved). Constraints that are not required may be missed; what is
/// missed is least by priority: a constraint is never given up for any number of constraints of lower
/// priorities, and among equals the sum of the misses is least. It knows nothing of views. Variables may be
/// negative.
class LayoutSolver {
public:
    using Variable = std::uint32_t;
    using ConstraintId = std::uint32_t;

    struct Term {
        Variable variable;
        double coefficient;
    };

    LayoutSolver();
    ~LayoutSolver();
    LayoutSolver(LayoutSolver&&) noexcept;
    LayoutSolver& operator=(LayoutSolver&&) noexcept;

    /// A variable that no constraint names is 0.
    Variable addVariable();
    /// The variable may be handed out again. Its constraints have to be removed first.
    void removeVariable(Variable variable);

    /// Adds: sum of terms (relation) constant. Nothing, and an unchanged system, when the constraint is
    /// required and contradicts what is required already.
    std::optional<ConstraintId> addConstraint(
        std::span<const Term> terms, LayoutRelation relation, double constant, LayoutPriority priority);
    /// Wishes a value for a variable, with a priority against more and one against less; both are below 1000,
    /// and 0 or less allows what it is about.
    ConstraintId addWish(
        Variable variable, double value, LayoutPriority againstMore, LayoutPriority againstLess);
    void removeConstraint(ConstraintId id);
    /// Takes effect with the next `solve`.
    void setConstant(ConstraintId id, double constant);

    /// Brings the values up to date. Answers the required constraints that had to be given up, because
    /// constants that were set contradict each other; they are removed, the younger before the older.
    std::vector<ConstraintId> solve();
    /// As of the last `solve`.
    double value(Variable variable) const;

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace kit
