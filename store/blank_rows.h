#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/store/worksheet_cells.h"

namespace dp {

// The blank rows of a worksheet: an ordered set of row numbers, kept as runs so that a sheet whose
// only cell is its last one costs a few bytes.
class DPXLSX_API BlankRows {
  public:
    // Adds the rows from `first` to `last` inclusive; they must lie after all rows added before.
    void append(std::uint32_t first, std::uint32_t last);

    // Whether `row` is blank.
    bool contains(std::uint32_t row) const {
        return countBetween(row, std::uint64_t{row} + 1) != 0;
    }
    // Number of blank rows r with from <= r < end; 0 when end is not above from.
    std::uint32_t countBetween(std::uint64_t from, std::uint64_t end) const;
    // Number of all blank rows.
    std::uint64_t size() const { return countBelow(std::uint64_t{1} << 32); }

  private:
    struct Run {
        std::uint32_t first;
        std::uint32_t last;
        std::uint64_t rowsBefore;  // blank rows of all earlier runs
    };

    std::uint64_t countBelow(std::uint64_t row) const;

    std::vector<Run> runs_;
};

// The rows from 0 to `last` in which no column that `counts` (0-based column) holds a cell. Takes
// time proportional to the number of stored cells, not to that of rows.
BlankRows findBlankRows(const WorksheetCells& cells, std::uint32_t last,
                        const std::function<bool(std::uint32_t)>& counts);

}  // namespace dp
