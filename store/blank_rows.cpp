#include "dpxlsx/store/blank_rows.h"

#include <algorithm>
#include <array>
#include <bit>
#include <map>

namespace dp {

namespace {

// One bit for each of 4096 adjacent rows. Pages are made only where there are cells: the rows of a
// hostile sheet may lie anywhere below 2^32, and one bit for every row would take half a gigabyte.
constexpr std::uint32_t kRowsPerPage = 4096;
using Page = std::array<std::uint64_t, kRowsPerPage / 64>;

class OccupiedRows {
  public:
    void addColumn(const CellColumn& column) {
        Page* page = nullptr;
        std::uint32_t pageNumber = 0;
        for (auto cell = column.begin(); cell != column.end(); ++cell) {
            const std::uint32_t row = cell->first;
            if (!page || row / kRowsPerPage != pageNumber) {
                pageNumber = row / kRowsPerPage;
                page = &pages_[pageNumber];
            }
            const std::uint32_t bit = row % kRowsPerPage;
            (*page)[bit / 64] |= std::uint64_t{1} << (bit % 64);
        }
    }

    // The rows from 0 to `last` that are not marked.
    BlankRows complement(std::uint32_t last) const {
        BlankRows blank;
        std::uint64_t next = 0;  // the first row not yet known to be blank or occupied
        for (const auto& [number, page] : pages_) {
            for (std::uint32_t word = 0; word < page.size(); ++word) {
                for (std::uint64_t marks = page[word]; marks != 0; marks &= marks - 1) {
                    const std::uint64_t row = std::uint64_t{number} * kRowsPerPage +
                                              std::uint64_t{word} * 64 +
                                              static_cast<unsigned>(std::countr_zero(marks));
                    if (row > last) break;
                    appendBetween(blank, next, row);
                    next = row + 1;
                }
            }
        }
        appendBetween(blank, next, std::uint64_t{last} + 1);
        return blank;
    }

  private:
    static void appendBetween(BlankRows& blank, std::uint64_t from, std::uint64_t end) {
        if (from < end)
            blank.append(static_cast<std::uint32_t>(from), static_cast<std::uint32_t>(end - 1));
    }

    std::map<std::uint32_t, Page> pages_;
};

}  // namespace

void BlankRows::append(std::uint32_t first, std::uint32_t last) {
    runs_.push_back({first, last, size()});
}

std::uint64_t BlankRows::countBelow(std::uint64_t row) const {
    const auto after = std::partition_point(runs_.begin(), runs_.end(),
                                            [row](const Run& run) { return run.first < row; });
    if (after == runs_.begin()) return 0;
    const Run& run = *std::prev(after);
    return run.rowsBefore + std::min(row, std::uint64_t{run.last} + 1) - run.first;
}

std::uint32_t BlankRows::countBetween(std::uint64_t from, std::uint64_t end) const {
    if (end <= from) return 0;
    return static_cast<std::uint32_t>(countBelow(end) - countBelow(from));
}

BlankRows findBlankRows(const WorksheetCells& cells, std::uint32_t last,
                        const std::function<bool(std::uint32_t)>& counts) {
    OccupiedRows occupied;
    for (auto column = cells.begin(); column != cells.end(); ++column)
        if (counts(column->first)) occupied.addColumn(column->second);
    return occupied.complement(last);
}

}  // namespace dp
