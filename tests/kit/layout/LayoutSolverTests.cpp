// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutSolver.h"

#include <gtest/gtest.h>

#include <array>
#include <map>
#include <random>

namespace kit {

namespace {

using Variable = LayoutSolver::Variable;
using Term = LayoutSolver::Term;
using enum LayoutRelation;

constexpr LayoutPriority required = LayoutPriorities::required;

struct Rule {
    std::vector<Term> terms;
    LayoutRelation relation;
    double constant;
    LayoutPriority priority;
};

std::optional<LayoutSolver::ConstraintId> add(LayoutSolver& solver, const Rule& rule)
{
    return solver.addConstraint(rule.terms, rule.relation, rule.constant, rule.priority);
}

double miss(const LayoutSolver& solver, const Rule& rule)
{
    double sum = -rule.constant;
    for (const auto& term : rule.terms)
        sum += term.coefficient * solver.value(term.variable);
    if (rule.relation == LessThanOrEqual)
        return std::max(0.0, sum);
    if (rule.relation == GreaterThanOrEqual)
        return std::max(0.0, -sum);
    return std::abs(sum);
}

/// Answers the sum of the misses at each priority, the highest first.
std::map<LayoutPriority, double, std::greater<>> misses(
    const LayoutSolver& solver, const std::vector<Rule>& rules)
{
    std::map<LayoutPriority, double, std::greater<>> sums;
    for (const auto& rule : rules)
        sums[rule.priority] += miss(solver, rule);
    return sums;
}

} // namespace

TEST(LayoutSolver, GivesUpAnyNumberOfLowPrioritiesForOneHigher)
{
    LayoutSolver solver;
    const auto width = solver.addVariable();
    for (int i = 0; i < 50; ++i)
        add(solver, {{{width, 1}}, Equal, 10, 250});
    add(solver, {{{width, 1}}, GreaterThanOrEqual, 40, 251});
    solver.solve();
    EXPECT_DOUBLE_EQ(solver.value(width), 40);
}

TEST(LayoutSolver, RefusesAContradictionAndGoesOnAsBefore)
{
    LayoutSolver solver;
    const auto a = solver.addVariable(), b = solver.addVariable();
    add(solver, {{{a, 1}}, LessThanOrEqual, 100, required});
    add(solver, {{{b, 1}, {a, -1}}, Equal, 0, required});
    EXPECT_FALSE(add(solver, {{{b, 1}}, GreaterThanOrEqual, 101, required}));
    EXPECT_FALSE(add(solver, {{{b, 1}, {a, -1}}, Equal, 5, required}));
    const auto wish = solver.addWish(b, 0, 500, 500);
    for (const auto& [wished, got] : {std::pair{60.0, 60.0}, {200.0, 100.0}, {-7.0, -7.0}}) {
        solver.setConstant(wish, wished);
        EXPECT_TRUE(solver.solve().empty());
        EXPECT_DOUBLE_EQ(solver.value(a), got);
    }
}

TEST(LayoutSolver, ReportsTheYoungestWhenConstantsComeToContradict)
{
    LayoutSolver solver;
    const auto a = solver.addVariable();
    const auto least = *add(solver, {{{a, 1}}, GreaterThanOrEqual, 10, required});
    const auto most = *add(solver, {{{a, 1}}, LessThanOrEqual, 20, required});
    add(solver, {{{a, 1}}, Equal, 0, 1});
    solver.setConstant(least, 30);
    EXPECT_EQ(solver.solve(), std::vector{most});
    EXPECT_DOUBLE_EQ(solver.value(a), 30);
}

TEST(LayoutSolver, ConstantsThatContradictOnlyOnTheWayAreNoConflict)
{
    LayoutSolver solver;
    const auto a = solver.addVariable(), b = solver.addVariable();
    const auto left = *add(solver, {{{a, 1}}, Equal, 0, required});
    const auto right = *add(solver, {{{b, 1}}, Equal, 100, required});
    add(solver, {{{b, 1}, {a, -1}}, GreaterThanOrEqual, 50, required});
    const auto twin = *add(solver, {{{a, 1}}, Equal, 0, required});
    solver.setConstant(left, 200);
    solver.setConstant(twin, 200);
    solver.setConstant(right, 300);
    EXPECT_TRUE(solver.solve().empty());
    EXPECT_DOUBLE_EQ(solver.value(a), 200);
    EXPECT_DOUBLE_EQ(solver.value(b), 300);
}

/// After any additions, removals and changes the outcome is as good as that of a fresh solver.
TEST(LayoutSolver, IncrementalWorkEndsWhereAFreshStartEnds)
{
    std::mt19937 random(20240917);
    const auto pick = [&random](int from, int to) { return std::uniform_int_distribution(from, to)(random); };
    constexpr std::array<LayoutPriority, 6> priorities{required, 999.5F, 750, 251, 250, 1};
    for (int round = 0; round < 60; ++round) {
        LayoutSolver solver;
        std::vector<Variable> variables(6);
        for (auto& variable : variables)
            variable = solver.addVariable();
        std::map<LayoutSolver::ConstraintId, Rule> active;
        for (int step = 0; step < 60; ++step) {
            const int deed = pick(0, 9);
            if (active.empty() || deed < 5) {
                const Rule rule{{{variables[pick(0, 2)], 1.0}, {variables[pick(3, 5)], pick(-2, 1) - 0.5}},
                    static_cast<LayoutRelation>(pick(0, 2)), static_cast<double>(pick(-100, 100)),
                    priorities[pick(0, 5)]};
                if (const auto id = add(solver, rule))
                    active[*id] = rule;
            } else {
                const auto chosen = std::next(active.begin(), pick(0, static_cast<int>(active.size()) - 1));
                if (deed < 7) {
                    solver.removeConstraint(chosen->first);
                    active.erase(chosen);
                } else {
                    chosen->second.constant = pick(-100, 100);
                    solver.setConstant(chosen->first, chosen->second.constant);
                }
            }
            for (const auto id : solver.solve())
                active.erase(id);
        }
        LayoutSolver fresh;
        std::vector<Rule> rules;
        for (std::size_t i = 0; i < variables.size(); ++i)
            fresh.addVariable();
        for (const auto& [id, rule] : active) {
            rules.push_back(rule);
            ASSERT_TRUE(add(fresh, rule)) << "round " << round;
        }
        ASSERT_TRUE(fresh.solve().empty());
        const auto expected = misses(fresh, rules);
        for (const auto& [priority, sum] : misses(solver, rules))
            ASSERT_NEAR(sum, expected.at(priority), 1e-5) << "round " << round << " priority " << priority;
        if (expected.contains(required)) {
            ASSERT_NEAR(expected.at(required), 0, 1e-6);
        }
    }
}

} // namespace kit
