#pragma once

#include <string_view>

namespace dp {

// Sets `column` to the 1-based column of a cell reference: 2 for "B7". The row digits are not read.
// Throws CmXmlException for a reference of less than 2 characters, one without a digit behind the
// first character, and a column beyond the last one of a worksheet.
void mDetermineCol(std::string_view reference, int& column);

// Where the next row or cell of a worksheet goes (0-based): to the place that it names, or right
// behind the one before it.
class CellPlace {
  public:
    // `number` is the 1-based row that the element names, null when it names none.
    // Throws CmXmlException for a row that no worksheet has.
    void beginRow(const int* number);
    // `reference` is null when the cell has none. Throws CmXmlException.
    void beginCell(const char* reference);

    unsigned row() const { return static_cast<unsigned>(row_); }
    unsigned column() const { return static_cast<unsigned>(column_); }

  private:
    int row_ = -1;
    int column_ = -1;
};

}  // namespace dp
