#include "dpxlsx/store/row_layout.h"

#include <algorithm>
#include <iterator>

namespace dp {

namespace {

bool isSet(std::uint32_t row) { return row != kNotSet; }

void setDefault(std::uint32_t& row, std::uint32_t value) {
    if (!isSet(row)) row = value;
}

enum class FirstRow { Nothing, Names, Data };

FirstRow classifyFirstRow(const WorksheetCells& cells) {
    FirstRow seen = FirstRow::Nothing;
    for (auto column = cells.begin(); column != cells.end(); ++column) {
        const auto cell = column->second.begin();
        if (cell == column->second.end() || cell->first != 0) continue;
        switch (cell->second.type()) {
            case CELL_INTEGER:
            case CELL_NUMBER:
            case CELL_DATETIME:
                return FirstRow::Data;
            case CELL_TEXT:
                seen = FirstRow::Names;
                break;
            default:
                break;
        }
    }
    return seen;
}

}  // namespace

void makeRowsZeroBased(SheetReadOptions& options) {
    if (!options.rowsOneBased) return;
    options.rowsOneBased = false;
    if (isSet(options.variableNameRow)) --options.variableNameRow;
    if (isSet(options.firstDataRow)) --options.firstDataRow;
}

void placeRows(SheetReadOptions& options) {
    if (options.variableNameRowSetting != VNR_GIVEN) {
        setDefault(options.firstDataRow, 0);
        return;
    }
    setDefault(options.variableNameRow, 0);
    setDefault(options.firstDataRow, options.variableNameRow + 1);
}

void inferRows(SheetReadOptions& options, const WorksheetCells& cells) {
    if (classifyFirstRow(cells) == FirstRow::Names) {
        options.variableNameRowSetting = VNR_GIVEN;
        options.variableNameRow = 0;
    } else {
        options.variableNameRowSetting = VNR_NONE;
    }
    placeRows(options);
}

std::uint32_t lastRow(const WorksheetCells& cells) {
    const std::uint64_t rows = cells.rowCount();
    return rows == 0 ? 0 : static_cast<std::uint32_t>(rows - 1);
}

std::uint32_t rowCountUpTo(const RowLayout& layout, std::uint32_t last) {
    const std::uint32_t difference = last + 1 - layout.firstDataRow;
    // The host's row counts are signed 32-bit numbers, in which a difference above 2^31 - 1 is
    // negative.
    const std::uint32_t available = difference > 0x7FFFFFFF ? 0 : difference;
    std::uint32_t count = std::min(available, layout.dataRowCount);
    if (layout.blankRows && available != 0) {
        const std::uint64_t first = layout.firstDataRow;
        count -= layout.blankRows->countBetween(first, first + count);
    }
    return count;
}

std::uint32_t unpaddedRowCount(const RowLayout& layout, const CellColumn& column) {
    if (column.empty()) return 0;
    auto end = column.end();
    if (std::uint64_t{layout.firstDataRow} + layout.dataRowCount <= 0xFFFFFFFF) {
        end = column.upper_bound(layout.firstDataRow + layout.dataRowCount - 1);
        if (end == column.begin()) return 0;
    }
    return rowCountUpTo(layout, std::prev(end)->first);
}

Gap gapBefore(const RowLayout& layout, std::uint32_t expectedRow, std::uint32_t cellRow) {
    Gap gap;
    gap.slots = cellRow - expectedRow;
    if (gap.slots == 0) return gap;
    std::uint32_t before = 0;
    if (layout.blankRows) {
        gap.slots -= layout.blankRows->countBetween(expectedRow, cellRow);
        const std::uint32_t handled = expectedRow == 0 ? 0 : expectedRow - 1;
        before = layout.blankRows->countBetween(layout.firstDataRow,
                                                std::max(handled, layout.firstDataRow));
    }
    gap.firstSlot = expectedRow - layout.firstDataRow - before;
    gap.emptyRows = gap.slots;
    return gap;
}

}  // namespace dp
