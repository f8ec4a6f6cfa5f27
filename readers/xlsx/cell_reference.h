#pragma once

namespace dp {

// Sets `column` to the 1-based column of a cell reference, 2 for "B7", or to one beyond the last
// when no worksheet has such a column. Returns where the row digits begin. Throws CmXmlException
// for a reference of less than 2 characters and for one without a digit after the first character.
const char* mDetermineCol(const char* reference, int& column);

// The position (0-based) of the next row or cell of a worksheet: the one that it names, or else the
// one after the previous row or cell. A row without a number takes it from the references of its
// cells. Positions may be beyond the worksheet, as long as there is no value.
class CellPlace {
  public:
    // `number` is the 1-based row that the element names, null when it names none.
    void beginRow(const int* number);
    // `reference` is null when the cell has none. Throws CmXmlException as
    // mDetermineCol does.
    void beginCell(const char* reference);

    // Of the current row and the last cell; 0 before the first ones.
    unsigned row() const { return row_; }
    unsigned column() const { return column_; }

  private:
    void goToRow(int number);

    unsigned row_ = 0;
    unsigned column_ = 0;
    int nextRow_ = 1;     // 1-based, like the next one
    int nextColumn_ = 1;  // of the current row
    bool rowIsNumbered_ = true;
};

}  // namespace dp
