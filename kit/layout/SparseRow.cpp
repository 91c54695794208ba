// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/SparseRow.h"

#include <algorithm>

namespace kit {

std::vector<SparseRow::Cell>::iterator SparseRow::find(Column column)
{
    return std::ranges::lower_bound(_cells, column, {}, &Cell::column);
}

double SparseRow::coefficient(Column column) const
{
    const auto cell = const_cast<SparseRow*>(this)->find(column);
    return cell != _cells.end() && cell->column == column ? cell->coefficient : 0;
}

void SparseRow::add(Column column, double coefficient)
{
    const auto cell = find(column);
    if (cell == _cells.end() || cell->column != column) {
        if (!isNearZero(coefficient))
            _cells.insert(cell, {column, coefficient});
        return;
    }
    cell->coefficient += coefficient;
    if (isNearZero(cell->coefficient))
        _cells.erase(cell);
}

double SparseRow::take(Column column)
{
    const auto cell = find(column);
    if (cell == _cells.end() || cell->column != column)
        return 0;
    const double coefficient = cell->coefficient;
    _cells.erase(cell);
    return coefficient;
}

void SparseRow::scale(double factor)
{
    constant *= factor;
    for (auto& cell : _cells)
        cell.coefficient *= factor;
}

void SparseRow::solveFor(Column column)
{
    scale(-1 / take(column));
}

void SparseRow::solveFor(Column from, Column to)
{
    add(from, -1);
    solveFor(to);
}

} // namespace kit
