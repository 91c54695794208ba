// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cmath>
#include <cstdint>
#include <vector>

namespace kit {

/// A linear expression in a few of many columns: constant + sum of coefficient * column.
class SparseRow {
public:
    using Column = std::uint32_t;

    struct Cell {
        Column column;
        double coefficient;
    };

    /// Smaller values count as 0, because they are far below any length that can be seen.
    static constexpr double epsilon = 1e-8;
    static bool isNearZero(double value) { return std::abs(value) < epsilon; }

    double constant = 0;

    /// The cells are sorted by column.
    const std::vector<Cell>& cells() const { return _cells; }
    double coefficient(Column column) const; ///< 0 for a column that is not there
    void add(Column column, double coefficient);
    /// Removes a column and answers its coefficient.
    double take(Column column);
    void scale(double factor);
    /// Turns 0 = this row into column = this row.
    void solveFor(Column column);
    /// Turns `from` = this row into `to` = this row.
    void solveFor(Column from, Column to);

    /// Adds another row times a factor, and calls `onNew` for each column that this row did not have before.
    template <typename OnNew>
    void addScaled(const SparseRow& other, double factor, OnNew&& onNew);

private:
    std::vector<Cell>::iterator find(Column column);

    std::vector<Cell> _cells;
};

template <typename OnNew>
void SparseRow::addScaled(const SparseRow& other, double factor, OnNew&& onNew)
{
    constant += factor * other.constant;
    thread_local std::vector<Cell> merged;
    merged.clear();
    auto mine = _cells.begin();
    for (const auto& cell : other._cells) {
        while (mine != _cells.end() && mine->column < cell.column)
            merged.push_back(*mine++);
        const bool isThere = mine != _cells.end() && mine->column == cell.column;
        const double sum = factor * cell.coefficient + (isThere ? mine++->coefficient : 0);
        if (isNearZero(sum))
            continue;
        merged.push_back({cell.column, sum});
        if (!isThere)
            onNew(cell.column);
    }
    merged.insert(merged.end(), mine, _cells.end());
    _cells.assign(merged.begin(), merged.end());
}

} // namespace kit
