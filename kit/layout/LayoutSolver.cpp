// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutSolver.h"

#include "kit/layout/SimplexTableau.h"

#include <algorithm>
#include <utility>

namespace kit {

namespace {

using Column = SimplexTableau::Column;
using Kind = SimplexTableau::Kind;

struct Stored {
    std::vector<LayoutSolver::Term> terms;
    LayoutRelation relation = LayoutRelation::Equal;
    double constant = 0;
    // A required constraint always holds. Another one may be missed upwards and downwards at these
    // priorities; 0 or less means that missing it costs nothing.
    bool isRequired = false;
    LayoutPriority againstMore = 0, againstLess = 0;
    bool inUse = false;
    // The marker column stands in this constraint's equation only. So does the second column, if there is
    // one.
    Column marker = 0;
    double markerCoefficient = 0;
    std::optional<Column> other;

    LayoutPriority priority() const
    {
        return isRequired ? LayoutPriorities::required : std::max(againstMore, againstLess);
    }
};

} // namespace

struct LayoutSolver::Impl {
    SimplexTableau tableau;
    std::vector<std::optional<Column>> variables;
    std::vector<Variable> unusedVariables;
    std::vector<Stored> constraints;
    std::vector<ConstraintId> unusedIds;
    std::vector<ConstraintId> givenUp;
    bool costsAreLeast = true;

    std::optional<ConstraintId> add(Stored constraint);
    bool place(Stored& constraint);
    SparseRow markedRow(Stored& constraint);
    std::optional<Column> subject(const SparseRow& row, const Stored& constraint) const;
    void addCosts(const Stored& constraint, double cost);
    void unplace(Stored& constraint);
    void makeFeasible();
    void makeCostsLeast();
    void rebuild();
};

/// Answers the constraint as an equation 0 = row. A required inequality gets one slack column. A constraint
/// that may be missed gets a column for too much (the marker) and one for too little.
SparseRow LayoutSolver::Impl::markedRow(Stored& constraint)
{
    SparseRow row;
    row.constant = -constraint.constant;
    for (const auto& term : constraint.terms)
        tableau.addTo(row, *variables[term.variable], term.coefficient);
    const bool isEquation = constraint.isRequired && constraint.relation == LayoutRelation::Equal;
    const bool hasUpperSlack =
        constraint.isRequired && constraint.relation == LayoutRelation::LessThanOrEqual;
    constraint.marker = tableau.addColumn(isEquation ? Kind::Dummy : Kind::Restricted);
    constraint.markerCoefficient = hasUpperSlack ? 1 : -1;
    row.add(constraint.marker, constraint.markerCoefficient);
    constraint.other.reset();
    if (!constraint.isRequired) {
        constraint.other = tableau.addColumn(Kind::Restricted);
        row.add(*constraint.other, 1);
        addCosts(constraint, 1);
    }
    if (row.constant < 0)
        row.scale(-1);
    return row;
}

void LayoutSolver::Impl::addCosts(const Stored& constraint, double cost)
{
    if (constraint.againstMore > 0)
        tableau.addCost(constraint.marker, constraint.againstMore, cost);
    if (constraint.againstLess > 0)
        tableau.addCost(*constraint.other, constraint.againstLess, cost);
}

/// Answers a column that can become basic at once.
std::optional<Column> LayoutSolver::Impl::subject(const SparseRow& row, const Stored& constraint) const
{
    // The free column that stands in the fewest rows is cheapest, because those rows have to be rewritten.
    std::optional<Column> free;
    for (const auto& cell : row.cells()) {
        if (tableau.kind(cell.column) == Kind::Free
            && (!free || tableau.occurrenceCount(cell.column) <= tableau.occurrenceCount(*free)))
            free = cell.column;
    }
    if (free)
        return free;
    if (tableau.kind(constraint.marker) == Kind::Restricted && row.coefficient(constraint.marker) < 0)
        return constraint.marker;
    if (constraint.other && row.coefficient(*constraint.other) < 0)
        return constraint.other;
    return std::nullopt;
}

bool LayoutSolver::Impl::place(Stored& constraint)
{
    SparseRow row = markedRow(constraint);
    costsAreLeast = false;
    if (const auto column = subject(row, constraint)) {
        tableau.addEquation(std::move(row), *column);
        return true;
    }
    const bool saysNothing = std::ranges::all_of(
        row.cells(), [this](const auto& cell) { return tableau.kind(cell.column) == Kind::Dummy; });
    bool isPossible = !saysNothing || SparseRow::isNearZero(row.constant);
    if (!saysNothing) {
        isPossible = tableau.addEquation(std::move(row));
    } else if (isPossible) {
        row.constant = 0;
        tableau.addEquation(std::move(row), constraint.marker);
    }
    if (!isPossible)
        tableau.freeColumn(constraint.marker);
    return isPossible;
}

void LayoutSolver::Impl::unplace(Stored& constraint)
{
    if (constraint.other)
        addCosts(constraint, -1);
    tableau.removeEquation(constraint.marker, constraint.other);
    tableau.freeColumn(constraint.marker);
    if (constraint.other)
        tableau.freeColumn(*constraint.other);
    costsAreLeast = false;
}

void LayoutSolver::Impl::makeCostsLeast()
{
    if (costsAreLeast)
        return;
    tableau.minimize();
    costsAreLeast = true;
}

void LayoutSolver::Impl::makeFeasible()
{
    if (!tableau.isFeasible() && !tableau.restoreFeasibility())
        rebuild();
}

/// Builds the tableau anew, the older constraints first, because the constants that were set contradict each
/// other.
void LayoutSolver::Impl::rebuild()
{
    tableau = {};
    for (auto& variable : variables) {
        if (variable)
            variable = tableau.addColumn(Kind::Free);
    }
    std::vector<ConstraintId> order;
    for (ConstraintId id = 0; id < constraints.size(); ++id) {
        if (constraints[id].inUse)
            order.push_back(id);
    }
    std::ranges::stable_sort(
        order, [this](auto a, auto b) { return constraints[a].priority() > constraints[b].priority(); });
    for (const auto id : order) {
        if (place(constraints[id]))
            continue;
        constraints[id].inUse = false;
        givenUp.push_back(id);
    }
}

LayoutSolver::LayoutSolver()
    : _impl(std::make_unique<Impl>())
{
}

LayoutSolver::~LayoutSolver() = default;
LayoutSolver::LayoutSolver(LayoutSolver&&) noexcept = default;
LayoutSolver& LayoutSolver::operator=(LayoutSolver&&) noexcept = default;

LayoutSolver::Variable LayoutSolver::addVariable()
{
    const auto column = _impl->tableau.addColumn(Kind::Free);
    if (_impl->unusedVariables.empty()) {
        _impl->variables.emplace_back(column);
        return static_cast<Variable>(_impl->variables.size() - 1);
    }
    const auto variable = _impl->unusedVariables.back();
    _impl->unusedVariables.pop_back();
    _impl->variables[variable] = column;
    return variable;
}

void LayoutSolver::removeVariable(Variable variable)
{
    _impl->tableau.freeColumn(*_impl->variables[variable]);
    _impl->variables[variable].reset();
    _impl->unusedVariables.push_back(variable);
}

std::optional<LayoutSolver::ConstraintId> LayoutSolver::addConstraint(
    std::span<const Term> terms, LayoutRelation relation, double constant, LayoutPriority priority)
{
    Stored constraint;
    constraint.terms = {terms.begin(), terms.end()};
    constraint.relation = relation;
    constraint.constant = constant;
    constraint.isRequired = priority >= LayoutPriorities::required;
    constraint.againstMore = relation == LayoutRelation::GreaterThanOrEqual ? 0 : priority;
    constraint.againstLess = relation == LayoutRelation::LessThanOrEqual ? 0 : priority;
    return _impl->add(std::move(constraint));
}

LayoutSolver::ConstraintId LayoutSolver::addWish(
    Variable variable, double value, LayoutPriority againstMore, LayoutPriority againstLess)
{
    Stored constraint;
    constraint.terms = {{variable, 1}};
    constraint.constant = value;
    constraint.againstMore = againstMore;
    constraint.againstLess = againstLess;
    return *_impl->add(std::move(constraint));
}

std::optional<LayoutSolver::ConstraintId> LayoutSolver::Impl::add(Stored constraint)
{
    makeFeasible();
    constraint.inUse = true;
    if (!place(constraint))
        return std::nullopt;
    if (unusedIds.empty()) {
        unusedIds.push_back(static_cast<ConstraintId>(constraints.size()));
        constraints.emplace_back();
    }
    const auto id = unusedIds.back();
    unusedIds.pop_back();
    constraints[id] = std::move(constraint);
    return id;
}

void LayoutSolver::removeConstraint(ConstraintId id)
{
    _impl->makeFeasible();
    auto& constraint = _impl->constraints[id];
    if (constraint.inUse)
        _impl->unplace(constraint);
    else if (std::erase(_impl->givenUp, id) == 0)
        return;
    constraint = {};
    _impl->unusedIds.push_back(id);
}

void LayoutSolver::setConstant(ConstraintId id, double constant)
{
    auto& constraint = _impl->constraints[id];
    const double change = constant - constraint.constant;
    if (!constraint.inUse || change == 0)
        return;
    _impl->makeCostsLeast();
    constraint.constant = constant;
    _impl->tableau.shift(constraint.marker, change / constraint.markerCoefficient);
}

std::vector<LayoutSolver::ConstraintId> LayoutSolver::solve()
{
    _impl->makeFeasible();
    _impl->makeCostsLeast();
    auto givenUp = std::exchange(_impl->givenUp, {});
    _impl->unusedIds.insert(_impl->unusedIds.end(), givenUp.begin(), givenUp.end());
    return givenUp;
}

double LayoutSolver::value(Variable variable) const
{
    return _impl->tableau.value(*_impl->variables[variable]);
}

} // namespace kit
