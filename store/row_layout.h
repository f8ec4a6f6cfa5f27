#pragma once

#include <algorithm>
#include <cstdint>

#include "dpxlsx/store/blank_rows.h"
#include "dpxlsx/store/read_options.h"
#include "dpxlsx/store/worksheet_cells.h"

// Derives concrete rows from the host's row options, and the value slots of a column from rows. All
// rows are 0-based here unless said otherwise; arithmetic on rows is that of unsigned 32-bit
// numbers.
namespace dp {

// Converts the host's 1-based rows to 0-based ones; does nothing when called again.
void makeRowsZeroBased(SheetReadOptions& options);

// Fills in the rows that the host did not give, for a worksheet whose setting is not VNR_INFER. A
// setting without a meaning counts as VNR_NONE.
void placeRows(SheetReadOptions& options);

// Decides from row 0 whether the worksheet has a row of variable names, and records the answer.
void inferRows(SheetReadOptions& options, const WorksheetCells& cells);

// The largest row that holds a cell; 0 for a worksheet without cells.
std::uint32_t lastRow(const WorksheetCells& cells);

// The rows that a load reads, and which of them it skips.
struct RowLayout {
    std::uint32_t firstDataRow = kNotSet;
    std::uint32_t dataRowCount = kNotSet;  // at most this many rows
    const BlankRows* blankRows = nullptr;  // null when blank rows are kept
};

// Rows of a column whose data ends in row `last`.
std::uint32_t rowCountUpTo(const RowLayout& layout, std::uint32_t last);

// Rows of a column that ends with its own last cell.
std::uint32_t unpaddedRowCount(const RowLayout& layout, const CellColumn& column);

// The value slots between two handled cells.
struct Gap {
    std::uint32_t slots = 0;      // to be skipped
    std::uint32_t firstSlot = 0;  // slot of the first row of the gap
    std::uint32_t emptyRows = 0;  // rows of the gap that are not blank
};

// The gap between `expectedRow`, the row after the cell handled last, and `cellRow`.
Gap gapBefore(const RowLayout& layout, std::uint32_t expectedRow, std::uint32_t cellRow);

// Calls `fill(slot)` for the slots of the gap's empty rows that lie below `rowCount`.
template <class Fill>
void fillGap(const Gap& gap, std::uint32_t rowCount, Fill fill) {
    const std::uint64_t end =
        std::min(std::uint64_t{gap.firstSlot} + gap.emptyRows, std::uint64_t{rowCount});
    for (std::uint64_t slot = gap.firstSlot; slot < end; ++slot) fill(slot);
}

// Calls `onCell(cell, slot)` for the cells from the first data row on, in row order, as long as
// their slots lie below `rowCount`, and `onGap(gap)` between cells of rows that are not adjacent.
// Returns whether any cell was handled.
template <class OnGap, class OnCell>
bool walkDataCells(const CellColumn& cells, const RowLayout& layout, std::uint32_t rowCount,
                   OnGap onGap, OnCell onCell) {
    std::uint32_t expectedRow = layout.firstDataRow;
    std::uint32_t slot = 0;
    bool handled = false;
    const auto end = cells.end();
    for (auto cell = cells.lower_bound(expectedRow); cell != end && slot < rowCount; ++cell) {
        const auto [row, content] = *cell;
        if (row != expectedRow) {
            const Gap gap = gapBefore(layout, expectedRow, row);
            onGap(gap);
            slot += gap.slots;
            if (slot >= rowCount) break;
        }
        expectedRow = row + 1;
        handled = true;
        onCell(content, slot);
        ++slot;
    }
    return handled;
}

}  // namespace dp
