#include "dpxlsx/readers/xlsx/cell_reference.h"

#include <algorithm>

#include "dpxlsx/formats/digits.h"
#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"

namespace dp {

const char* mDetermineCol(const char* reference, int& column) {
    int value = 0;
    const char* letter = reference;
    do {
        if (*letter == '\0') throw CmXmlException(kXmlError);
        // Beyond these bounds no further letter can lead back to a valid column.
        if (value >= -kWorksheetColumns && value <= kWorksheetColumns * 26)
            value = value * 26 + (static_cast<unsigned char>(*letter) - 64);
        ++letter;
    } while (!isDigit(*letter));
    const bool exists = value >= 1 && value <= kWorksheetColumns;
    column = exists ? value : kWorksheetColumns + 1;
    return letter;
}

void CellPlace::beginRow(const int* number) {
    rowIsNumbered_ = number != nullptr;
    goToRow(number ? *number : nextRow_);
    nextColumn_ = 1;
}

void CellPlace::goToRow(int number) {
    const bool exists = number >= 1 && number <= kWorksheetRows;
    row_ = static_cast<unsigned>(exists ? number - 1 : kWorksheetRows);
    nextRow_ = static_cast<int>(row_) + 2;
}

void CellPlace::beginCell(const char* reference) {
    int column = nextColumn_;
    if (reference) {
        const char* const digits = mDetermineCol(reference, column);
        int row = 0;
        if (!rowIsNumbered_ && CmXmlCast::instance().mCast(row, digits)) goToRow(row);
    }
    column_ = static_cast<unsigned>(column - 1);
    nextColumn_ = std::min(column, kWorksheetColumns) + 1;
}

}  // namespace dp
