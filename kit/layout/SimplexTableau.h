// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutAnchor.h"
#include "kit/layout/SparseRow.h"

#include <functional>
#include <map>
#include <optional>

namespace kit {

/// A simplex tableau in basic feasible form with one objective for each priority. The objectives are
/// minimised in the order of the priorities. It knows columns, not constraints: `LayoutSolver` translates.
///
/// A column is basic (it has a row that says what it equals) or not (then it is 0). A free column that became
/// basic stays basic; a free column that is not basic stands only in rows of other free columns. The rows of
/// restricted columns name no basic column. The rows of free columns take no part in the pivots and are
/// brought up to date only when they are needed, so until then they may name restricted columns that have
/// become basic.
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
    /// Releases a column that stands in no equation any more.
    void freeColumn(Column column);
    Kind kind(Column column) const { return _columns[column].kind; }
    double value(Column column) const;
    /// Answers an upper bound of the number of rows in which a free column stands.
    std::size_t occurrenceCount(Column column) const { return _columns[column].inFreeRows.size(); }

    /// Adds `factor` times a column to an expression. A basic column is replaced by its row.
    void addTo(SparseRow& expression, Column column, double factor);
    void addCost(Column column, LayoutPriority priority, double cost);

    /// Adds the equation 0 = `row` by making `subject`, a column of it, basic.
    void addEquation(SparseRow row, Column subject);
    /// Adds the equation 0 = `row`, whose constant is not negative, where no column can become basic at once.
    /// Answers false, and changes nothing, when the equation contradicts the others.
    bool addEquation(SparseRow row);
    /// Removes the one equation in which the marker stands, and with it the other column, if there is one.
    void removeEquation(Column marker, std::optional<Column> other);
    /// Changes the constant of the one equation in which the marker stands, as if the marker were less by
    /// this amount.
    void shift(Column marker, double amount);

    /// Minimises the objectives. It ends before the optimum only after a numerical breakdown.
    void minimize();
    /// Makes rows whose constants have become negative feasible again. Answers false when that is impossible.
    bool restoreFeasibility();
    bool isFeasible() const { return _infeasible.empty(); }

private:
    static constexpr std::int32_t noRow = -1;
    struct ColumnState {
        Kind kind = Kind::Unused;
        std::int32_t row = noRow; ///< the row in which the column is basic
        // The rows in which the column may stand, by the kind of their basic columns. Stale entries are
        // removed when a list is read.
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
    void bringUpToDate(std::int32_t index);
    std::int32_t insertRow(Column basic, SparseRow row);
    SparseRow removeRow(std::int32_t index);
    void substitute(std::int32_t index, Column column, const SparseRow& replacement);
    void substituteInRestrictedRows(Column column, const SparseRow& replacement);
    void substituteInFreeRows(Column column, const SparseRow& replacement);
    void substituteInCosts(Column column, const SparseRow& replacement);
    void pivot(std::int32_t index, Column entering);
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
