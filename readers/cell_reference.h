#pragma once

#include <string_view>

namespace dp {

// The size of a worksheet. Readers treat cells beyond it as an error: no program writes them, and
// work that is proportional to row and column numbers would be unbounded.
inline constexpr int kWorksheetRows = 1'048'576;
inline constexpr int kWorksheetColumns = 16'384;

// Sets `column` to the 1-based column of a cell reference: 2 for "B7". The row digits are not read.
// Throws CmXmlException for a reference of less than 2 characters, one without a digit behind the
// first character, and a column beyond the last one of a worksheet.
void mDetermineCol(std::string_view reference, int& column);

// The position (0-based) of the next row or cell of a worksheet: the one that it names, or else the
// one after the previous row or cell.
class CellPlace {
  public:
    // `number` is the 1-based row that the element names, null when it names none.
    // Throws CmXmlException for a row that no worksheet has.
    void beginRow(const int* number);
    // `reference` is null when the cell has none. Throws CmXmlException.
    void beginCell(const char* reference);

    // Of the current row and the last cell; 0 before the first ones.
    unsigned row() const { return row_; }
    unsigned column() const { return column_; }

  private:
    unsigned row_ = 0;
    unsigned column_ = 0;
    int nextRow_ = 1;     // 1-based, like the next one
    int nextColumn_ = 1;  // of the current row
};

}  // namespace dp
