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
/// method (a simplex tableau that is kept solved). Constraints that are not required may be missed. A
/// constraint is never missed for the sake of any number of constraints of lower priorities, and the sum of
/// the misses at one priority is as small as possible. The solver knows nothing of views. Variables may be
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

    /// Adds a variable, which is 0 until a constraint names it.
    Variable addVariable();
    /// Removes a variable, whose number may be used again. Its constraints have to be removed first.
    void removeVariable(Variable variable);

    /// Adds: sum of terms (relation) constant. Answers nothing, and leaves the system unchanged, when the
    /// constraint is required and contradicts the required ones.
    std::optional<ConstraintId> addConstraint(
        std::span<const Term> terms, LayoutRelation relation, double constant, LayoutPriority priority);
    /// Wishes a value for a variable, with one priority against a larger and one against a smaller value.
    /// Both are below 1000; 0 or less allows that deviation freely.
    ConstraintId addWish(
        Variable variable, double value, LayoutPriority againstMore, LayoutPriority againstLess);
    void removeConstraint(ConstraintId id);
    /// The constant takes effect with the next `solve`.
    void setConstant(ConstraintId id, double constant);

    /// Brings the values up to date. Answers the required constraints that it removed because constants that
    /// were set contradict each other; it removes the younger before the older.
    std::vector<ConstraintId> solve();
    /// Answers the value as of the last `solve`.
    double value(Variable variable) const;

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace kit
