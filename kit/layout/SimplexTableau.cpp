// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/SimplexTableau.h"

#include <algorithm>
#include <limits>

namespace kit {

namespace {

// The objective of the first phase, while an equation is being added, comes before every priority.
constexpr LayoutPriority firstPhase = 1e9F;
// A layout takes a few pivots for each constraint. This bound ends the search after a numerical breakdown.
constexpr int maximumPivots = 20000;

} // namespace

SimplexTableau::Column SimplexTableau::addColumn(Kind kind)
{
    if (_unusedColumns.empty()) {
        _columns.push_back({kind, noRow, {}, {}});
        return static_cast<Column>(_columns.size() - 1);
    }
    const Column column = _unusedColumns.back();
    _unusedColumns.pop_back();
    _columns[column] = {kind, noRow, {}, {}};
    return column;
}

void SimplexTableau::freeColumn(Column column)
{
    if (_columns[column].row != noRow)
        removeRow(_columns[column].row);
    for (const auto row : restrictedRowsWith(column))
        _rows[row].row.take(column);
    for (const auto row : freeRowsWith(column))
        _rows[row].row.take(column);
    for (auto& [priority, level] : _levels)
        level.take(column);
    _columns[column] = {};
    _unusedColumns.push_back(column);
}

double SimplexTableau::value(Column column) const
{
    const auto index = _columns[column].row;
    if (index == noRow)
        return 0;
    const auto& row = _rows[index].row;
    double value = row.constant;
    if (kind(column) == Kind::Free) {
        for (const auto& cell : row.cells()) {
            if (const auto inner = _columns[cell.column].row; inner != noRow)
                value += cell.coefficient * _rows[inner].row.constant;
        }
    }
    return value;
}

void SimplexTableau::addTo(SparseRow& expression, Column column, double factor)
{
    const auto row = _columns[column].row;
    if (row == noRow) {
        expression.add(column, factor);
        return;
    }
    if (kind(column) == Kind::Free)
        bringUpToDate(row);
    expression.addScaled(_rows[row].row, factor, [](Column) {});
}

/// Replaces the restricted columns of a free column's row that have become basic.
void SimplexTableau::bringUpToDate(std::int32_t index)
{
    auto& row = _rows[index].row;
    const auto isBasic = [this](const auto& cell) { return _columns[cell.column].row != noRow; };
    const auto& cells = row.cells();
    for (auto cell = std::ranges::find_if(cells, isBasic); cell != cells.end();
         cell = std::ranges::find_if(cells, isBasic))
        substitute(index, cell->column, _rows[_columns[cell->column].row].row);
}

void SimplexTableau::addCost(Column column, LayoutPriority priority, double cost)
{
    addTo(_levels[priority], column, cost);
}

/// Answers the rows that really contain the column, each once, and drops the others from the list.
const std::vector<std::int32_t>& SimplexTableau::weeded(
    Column column, std::vector<std::int32_t>& rows, bool restricted)
{
    ++_stamp;
    std::erase_if(rows, [&](std::int32_t index) {
        auto& row = _rows[index];
        // The index may have been reused for a row of the other kind.
        if (!row.inUse || isRestricted(index) != restricted || row.stamp == _stamp
            || row.row.coefficient(column) == 0)
            return true;
        row.stamp = _stamp;
        return false;
    });
    return rows;
}

const std::vector<std::int32_t>& SimplexTableau::restrictedRowsWith(Column column)
{
    return weeded(column, _columns[column].inRestrictedRows, true);
}

const std::vector<std::int32_t>& SimplexTableau::freeRowsWith(Column column)
{
    return weeded(column, _columns[column].inFreeRows, false);
}

std::vector<std::int32_t>& SimplexTableau::occurrences(Column column, std::int32_t row)
{
    return isRestricted(row) ? _columns[column].inRestrictedRows : _columns[column].inFreeRows;
}

std::int32_t SimplexTableau::insertRow(Column basic, SparseRow row)
{
    if (_unusedRows.empty()) {
        _unusedRows.push_back(static_cast<std::int32_t>(_rows.size()));
        _rows.emplace_back();
    }
    const auto index = _unusedRows.back();
    _unusedRows.pop_back();
    _rows[index] = {basic, true, 0, std::move(row)};
    for (const auto& cell : _rows[index].row.cells())
        occurrences(cell.column, index).push_back(index);
    _columns[basic].row = index;
    return index;
}

SparseRow SimplexTableau::removeRow(std::int32_t index)
{
    _rows[index].inUse = false;
    _columns[_rows[index].basic].row = noRow;
    _unusedRows.push_back(index);
    std::erase(_infeasible, index);
    return std::move(_rows[index].row);
}

void SimplexTableau::substitute(std::int32_t index, Column column, const SparseRow& replacement)
{
    auto& row = _rows[index].row;
    const double factor = row.take(column);
    row.addScaled(replacement, factor, [&](Column added) { occurrences(added, index).push_back(index); });
}

void SimplexTableau::substituteInRestrictedRows(Column column, const SparseRow& replacement)
{
    for (const auto index : restrictedRowsWith(column)) {
        substitute(index, column, replacement);
        auto& constant = _rows[index].row.constant;
        if (constant >= 0)
            continue;
        if (constant > -SparseRow::epsilon)
            constant = 0;
        else
            _infeasible.push_back(index);
    }
    _columns[column].inRestrictedRows.clear();
}

void SimplexTableau::substituteInFreeRows(Column column, const SparseRow& replacement)
{
    for (const auto index : freeRowsWith(column))
        substitute(index, column, replacement);
    _columns[column].inFreeRows.clear();
}

void SimplexTableau::substituteInCosts(Column column, const SparseRow& replacement)
{
    for (auto& [priority, level] : _levels) {
        if (const double factor = level.take(column); factor != 0)
            level.addScaled(replacement, factor, [](Column) {});
    }
}

void SimplexTableau::pivot(std::int32_t index, Column entering)
{
    const Column leaving = _rows[index].basic;
    if (kind(leaving) == Kind::Free)
        bringUpToDate(index);
    SparseRow row = removeRow(index);
    row.solveFor(leaving, entering);
    substituteInRestrictedRows(entering, row);
    // The rows of free columns are rewritten as well, because a free column that they name may not stay
    // hidden behind a basic column.
    if (kind(leaving) == Kind::Free)
        substituteInFreeRows(entering, row);
    substituteInCosts(entering, row);
    insertRow(entering, std::move(row));
}

void SimplexTableau::addEquation(SparseRow row, Column subject)
{
    row.solveFor(subject);
    if (kind(subject) == Kind::Free)
        substituteInFreeRows(subject, row);
    else
        substituteInCosts(subject, row);
    insertRow(subject, std::move(row));
}

bool SimplexTableau::addEquation(SparseRow row)
{
    const Column artificial = addColumn(Kind::Restricted);
    _levels[firstPhase] = row;
    insertRow(artificial, std::move(row));
    minimizeLevel(_levels.begin());
    const auto index = _columns[artificial].row;
    _levels.erase(firstPhase);
    if (index != noRow && !SparseRow::isNearZero(_rows[index].row.constant)) {
        freeColumn(artificial);
        return false;
    }
    if (index != noRow) {
        // Any column may take its place at 0. A row without columns says 0 = 0 and is dropped.
        const auto& cells = _rows[index].row.cells();
        const auto entering = std::ranges::find_if(
            cells, [this](const auto& cell) { return kind(cell.column) != Kind::Dummy; });
        if (entering != cells.end())
            pivot(index, entering->column);
        else if (!cells.empty())
            pivot(index, cells.front().column);
    }
    freeColumn(artificial);
    return true;
}

void SimplexTableau::removeEquation(Column marker, std::optional<Column> other)
{
    if (_columns[marker].row == noRow) {
        const auto row = rowForMarker(marker);
        if (row == noRow)
            return;
        pivot(row, marker);
    }
    // This equation alone joins the two columns, so taking the marker out of every other row takes out both.
    const auto behind = freeRowsWith(marker);
    for (const auto row : behind)
        bringUpToDate(row);
    if (other) {
        const auto beside = freeRowsWith(*other);
        for (const auto row : beside)
            bringUpToDate(row);
    }
    removeRow(_columns[marker].row);
}

/// Answers the row through which a marker can become basic without making other rows negative.
std::int32_t SimplexTableau::rowForMarker(Column marker)
{
    std::int32_t falling = noRow, rising = noRow;
    double leastFalling = std::numeric_limits<double>::max(), leastRising = leastFalling;
    for (const auto index : restrictedRowsWith(marker)) {
        const auto& row = _rows[index].row;
        const double coefficient = row.coefficient(marker);
        if (coefficient < 0 && -row.constant / coefficient < leastFalling) {
            leastFalling = -row.constant / coefficient;
            falling = index;
        } else if (coefficient > 0 && row.constant / coefficient < leastRising) {
            leastRising = row.constant / coefficient;
            rising = index;
        }
    }
    if (falling != noRow || rising != noRow)
        return falling != noRow ? falling : rising;
    const auto& freeRows = freeRowsWith(marker);
    return freeRows.empty() ? noRow : freeRows.front();
}

void SimplexTableau::shift(Column marker, double amount)
{
    const auto adjust = [this](std::int32_t index, double change) {
        auto& row = _rows[index];
        row.row.constant += change;
        if (SparseRow::isNearZero(row.row.constant))
            row.row.constant = 0;
        const bool isWrong = kind(row.basic) == Kind::Dummy ? row.row.constant != 0 : row.row.constant < 0;
        if (isWrong)
            _infeasible.push_back(index);
    };
    if (_columns[marker].row != noRow)
        adjust(_columns[marker].row, amount);
    for (const auto index : restrictedRowsWith(marker))
        adjust(index, -amount * _rows[index].row.coefficient(marker));
    for (const auto index : freeRowsWith(marker))
        _rows[index].row.constant -= amount * _rows[index].row.coefficient(marker);
}

void SimplexTableau::minimize()
{
    for (auto level = _levels.begin(); level != _levels.end(); ++level) {
        if (!minimizeLevel(level))
            return;
    }
}

bool SimplexTableau::minimizeLevel(Levels::iterator level)
{
    for (int pivots = 0; pivots < maximumPivots; ++pivots) {
        const auto entering = enteringColumn(level);
        if (!entering)
            return true;
        const auto row = leavingRow(*entering);
        if (row == noRow) {
            // An objective is a sum of terms that are never negative, so it can only fall further by a
            // rounding error.
            level->second.take(*entering);
            continue;
        }
        pivot(row, *entering);
    }
    return false;
}

/// Answers the first column that lowers this objective and leaves those of higher priority as they are.
std::optional<SimplexTableau::Column> SimplexTableau::enteringColumn(Levels::const_iterator level) const
{
    for (const auto& cell : level->second.cells()) {
        if (cell.coefficient > -SparseRow::epsilon || kind(cell.column) == Kind::Dummy)
            continue;
        const bool isFreeAbove = std::all_of(_levels.begin(), level,
            [&](const auto& above) { return SparseRow::isNearZero(above.second.coefficient(cell.column)); });
        if (isFreeAbove)
            return cell.column;
    }
    return std::nullopt;
}

std::int32_t SimplexTableau::leavingRow(Column entering)
{
    std::int32_t found = noRow;
    double least = std::numeric_limits<double>::max();
    for (const auto index : restrictedRowsWith(entering)) {
        const auto& row = _rows[index].row;
        const double coefficient = row.coefficient(entering);
        // A basic dummy column may neither grow nor shrink.
        if (coefficient > 0 && kind(_rows[index].basic) != Kind::Dummy)
            continue;
        const double ratio = std::abs(row.constant / coefficient);
        // The lowest of equal columns leaves, because degenerate pivots could otherwise go round in circles.
        if (ratio < least || (ratio == least && _rows[index].basic < _rows[found].basic)) {
            least = ratio;
            found = index;
        }
    }
    return found;
}

bool SimplexTableau::restoreFeasibility()
{
    for (int pivots = 0; !_infeasible.empty(); ++pivots) {
        const auto index = _infeasible.back();
        _infeasible.pop_back();
        auto& row = _rows[index];
        if (!row.inUse || SparseRow::isNearZero(row.row.constant))
            continue;
        const bool isDummy = kind(row.basic) == Kind::Dummy;
        if (!isDummy && row.row.constant > 0)
            continue;
        const auto entering = isDummy ? std::nullopt : dualEntering(row.row);
        if (!entering || pivots > maximumPivots) {
            _infeasible.clear();
            return false;
        }
        pivot(index, *entering);
    }
    return true;
}

/// Answers, of the columns that lift the row, the one that raises the objectives least.
std::optional<SimplexTableau::Column> SimplexTableau::dualEntering(const SparseRow& row) const
{
    std::optional<SparseRow::Cell> best;
    for (const auto& cell : row.cells()) {
        if (cell.coefficient < SparseRow::epsilon || kind(cell.column) == Kind::Dummy)
            continue;
        if (!best || costsLess(cell.column, cell.coefficient, best->column, best->coefficient))
            best = cell;
    }
    return best ? std::optional(best->column) : std::nullopt;
}

bool SimplexTableau::costsLess(Column a, double scaleA, Column b, double scaleB) const
{
    for (const auto& [priority, level] : _levels) {
        const double difference = level.coefficient(a) / scaleA - level.coefficient(b) / scaleB;
        if (!SparseRow::isNearZero(difference))
            return difference < 0;
    }
    return false;
}

} // namespace kit
