#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace dp::standard {

// 0-based; may be beyond the worksheet as long as there is no value.
struct CellPosition {
    std::uint32_t row = 0;
    std::uint32_t column = 0;

    bool operator==(const CellPosition&) const = default;
};

// The position that a reference such as "B7" names, in either case. Nothing for a text that is no
// reference; rows and columns that no worksheet has are the one beyond the last.
std::optional<CellPosition> parseReference(std::string_view text);

// Where the cells of a worksheet are: at the position that their references name, or where they
// follow in a row, and rows after each other.
class CellOrder {
  public:
    // `number` is the row's own, 1-based.
    void beginRow(std::optional<int> number);
    CellPosition cell(std::optional<CellPosition> reference);

  private:
    std::uint32_t nextRow_ = 0;
    CellPosition next_;
};

}  // namespace dp::standard
