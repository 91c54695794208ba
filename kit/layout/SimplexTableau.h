// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutAnchor.h"
#include "kit/layout/SparseRow.h"

#include <functional>
#include <map>
#include <optional>

namespace kit {

/// A simplex tableau in basic feasible form with one objective for each priority; the objectives are
/// minimised in the order of the priorities. The solver's engine room: it knows columns, not constraints.
///
/// A column is basic (it has a row that says what it equals) or not (then it is 0). Free columns, once basic,
/// stay so; a free column that is not basic stands in rows of other free columns only. The rows of restricted
/// columns name no basic column. The rows of free columns, which take no part in the pivots, are brought up
/// to date only when they are needed: until then they may name restricted columns that have become basic.
class SimplexTableau {
public:
    using Column = SparseRow::Column;

    enum class Kind : std::uint8_t {
        Unused,
        Free, ///< any value
        Restricted, ///< never negative
        Dummy, ///< always 0: marks a required equation
    };

    Column addColumn(Kind kind);
    /// Frees a column that stands in no equation any more.
    void freeColumn(Column column);
    Kind kind(Column column) const { return _columns[column].kind; }
    double value(Column column) const;
    /// In how many rows a free column stands, at most.
    std::size_t occurrenceCount(Column column) const { return _columns[column].inFreeRows.size(); }

    /// Adds `factor` times a column to an expression, by its row when it is basic.
    void addTo(SparseRow& expression, Column column, double factor);
    void addCost(Column column, LayoutPriority priority, double cost);

    /// Adds the equation 0 = `row` by making `subject`, a column of it, basic.
    void addEquation(SparseRow row, Column subject);
    /// Adds the equation 0 = `row`, whose constant is not negative, where no column can be basic at once.
    /// False, and no change, when the equation contradicts the others.
    bool addEquation(SparseRow row);
    /// Removes the one equation that the marker stands in, and the other column with it, if there is one.
    void removeEquation(Column marker, std::optional<Column> other);
    /// Changes the one equation that the marker stands in as if the marker had this much less.
    void shift(Column marker, double amount);

    /// Makes the objectives least. Does not terminate early but on a numerical breakdown.
    void minimize();
    /// Makes rows whose constants have become negative feasible again. False: there is no way.
    bool restoreFeasibility();
    bool isFeasible() const { return _infeasible.empty(); }

private:
    static constexpr std::int32_t noRow = -1;
    struct ColumnState {
        Kind kind = Kind::Unused;
        std::int32_t row = noRow; ///< where it is basic
        // Rows that it may stand in, by the kind of their basic columns; stale entries are weeded out.
        std::vector<std::int32_t> inRestrictedRows, inFreeRows;
    };
    struct BasicRow {
        Column basic = 0;
        bool inUse = false;
        std::uint64_t stamp = 0;
        SparseRow row;
    };
    using Levels = std::map<LayoutPriority, SparseRow, std::greater<>>;

    const std::vector<std::int32_t>& weeded(Column column, std::vector<std::int32_t>& rows, bool restricted);
    const std::vector<std::int32_t>& restrictedRowsWith(Column column);
    const std::vector<std::int32_t>& freeRowsWith(Column column);
    std::vector<std::int32_t>& occurrences(Column column, std::int32_t row);
    void bringUpToDate(std::int32_t row);
    std::int32_t insertRow(Column basic, SparseRow row);
    SparseRow removeRow(std::int32_t index);
    void substitute(std::int32_t row, Column column, const SparseRow& replacement);
    void substituteInRestrictedRows(Column column, const SparseRow& replacement);
    void substituteInFreeRows(Column column, const SparseRow& replacement);
    void substituteInCosts(Column column, const SparseRow& replacement);
    void pivot(std::int32_t row, Column entering);
    bool minimizeLevel(Levels::iterator level);
    std::optional<Column> enteringColumn(Levels::const_iterator level) const;
    std::int32_t leavingRow(Column entering);
    std::int32_t rowForMarker(Column marker);
    std::optional<Column> dualEntering(const SparseRow& row) const;
    bool costsLess(Column a, double scaleA, Column b, double scaleB) const;
    bool isRestricted(std::int32_t row) const { return kind(_rows[row].basic) != Kind::Free; }

    std::vector<ColumnState> _columns;
    std::vector<Column> _unusedColumns;
    std::vector<BasicRow> _rows;
    std::vector<std::int32_t> _unusedRows;
    std::vector<std::int32_t> _infeasible;
    Levels _levels;
    std::uint64_t _stamp = 0;
};

} // namespace kit
