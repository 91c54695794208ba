#include "platform/ui/LayoutSolver.h"

#include "platform/ui/SimplexTableau.h"

#include <algorithm>
#include <utility>

namespace platform::ui {

namespace {

using Column = SimplexTableau::Column;
using Kind = SimplexTableau::Kind;

struct Stored {
    std::vector<LayoutSolver::Term> terms;
    LayoutRelation relation = LayoutRelation::Equal;
    double constant = 0;
    LayoutPriority priority = LayoutPriorities::required;
    bool inUse = false;
    // The marker stands in this constraint's equation only; so does the second column, if there is one.
    Column marker = 0;
    double markerCoefficient = 0;
    std::optional<Column> other;

    bool isRequired() const { return priority >= LayoutPriorities::required; }
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

    bool place(Stored& constraint);
    SparseRow markedRow(Stored& constraint);
    std::optional<Column> subject(const SparseRow& row, const Stored& constraint) const;
    void addCosts(const Stored& constraint, double cost);
    void unplace(Stored& constraint);
    void makeFeasible();
    void makeCostsLeast();
    void rebuild();
};

/// The constraint as an equation 0 = row. A miss and, in an inequality, the slack are columns of their own.
SparseRow LayoutSolver::Impl::markedRow(Stored& constraint)
{
    SparseRow row;
    row.constant = -constraint.constant;
    for (const auto& term : constraint.terms)
        tableau.addTo(row, *variables[term.variable], term.coefficient);
    constraint.other.reset();
    if (constraint.relation == LayoutRelation::Equal && constraint.isRequired()) {
        constraint.marker = tableau.addColumn(Kind::Dummy);
        constraint.markerCoefficient = 1;
    } else {
        constraint.marker = tableau.addColumn(Kind::Restricted);
        constraint.markerCoefficient = constraint.relation == LayoutRelation::LessThanOrEqual ? 1 : -1;
    }
    row.add(constraint.marker, constraint.markerCoefficient);
    if (!constraint.isRequired()) {
        constraint.other = tableau.addColumn(Kind::Restricted);
        row.add(*constraint.other, -constraint.markerCoefficient);
        addCosts(constraint, 1);
    }
    if (row.constant < 0)
        row.scale(-1);
    return row;
}

void LayoutSolver::Impl::addCosts(const Stored& constraint, double cost)
{
    tableau.addCost(*constraint.other, constraint.priority, cost);
    if (constraint.relation == LayoutRelation::Equal)
        tableau.addCost(constraint.marker, constraint.priority, cost);
}

/// A column that can be basic at once.
std::optional<Column> LayoutSolver::Impl::subject(const SparseRow& row, const Stored& constraint) const
{
    for (const auto& cell : row.cells()) {
        if (tableau.kind(cell.column) == Kind::Free)
            return cell.column;
    }
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
    const bool saysNothing = std::all_of(row.cells().begin(), row.cells().end(),
        [this](const auto& cell) { return tableau.kind(cell.column) == Kind::Dummy; });
    bool isPossible = true;
    if (!saysNothing)
        isPossible = tableau.addEquation(std::move(row));
    else if ((isPossible = SparseRow::isNearZero(row.constant))) {
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
    tableau.removeEquation(constraint.marker);
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

/// The way out when constants contradict each other: everything anew, the older constraints first.
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
    std::stable_sort(order.begin(), order.end(),
        [this](auto a, auto b) { return constraints[a].priority > constraints[b].priority; });
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
    _impl->makeFeasible();
    Stored constraint{{terms.begin(), terms.end()}, relation, constant, priority, true, 0, 0, {}};
    if (!_impl->place(constraint))
        return std::nullopt;
    if (_impl->unusedIds.empty()) {
        _impl->constraints.push_back(std::move(constraint));
        return static_cast<ConstraintId>(_impl->constraints.size() - 1);
    }
    const auto id = _impl->unusedIds.back();
    _impl->unusedIds.pop_back();
    _impl->constraints[id] = std::move(constraint);
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

LayoutSolver::ConstraintId LayoutSolver::addEdit(Variable variable, LayoutPriority priority)
{
    const Term term{variable, 1};
    return *addConstraint({&term, 1}, LayoutRelation::Equal, 0, priority);
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

} // namespace platform::ui
