#include "readers/cell_reference.h"

#include <algorithm>

#include "readers/xml_reader.h"

namespace dp {

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }

}  // namespace

void mDetermineCol(std::string_view reference, int& column) {
    if (reference.size() < 2) throw CmXmlException(kXmlError);
    const auto digit = std::find_if(reference.begin() + 1, reference.end(), isDigit);
    if (digit == reference.end()) throw CmXmlException(kXmlError);
    long value = 0;
    for (auto letter = reference.begin(); letter != digit; ++letter) {
        value = value * 26 + (static_cast<unsigned char>(*letter) - 64);
        // From here on no further letter can make it a valid column again.
        if (value > kWorksheetColumns * 26L || value < -kWorksheetColumns)
            throw CmXmlException(kXmlError);
    }
    if (value < 1 || value > kWorksheetColumns) throw CmXmlException(kXmlError);
    column = static_cast<int>(value);
}

void CellPlace::beginRow(const int* number) {
    const int row = number ? *number : nextRow_;
    if (row < 1 || row > kWorksheetRows) throw CmXmlException(kXmlError);
    row_ = static_cast<unsigned>(row - 1);
    nextRow_ = row + 1;
    nextColumn_ = 1;
}

void CellPlace::beginCell(const char* reference) {
    int column = nextColumn_;
    if (reference)
        mDetermineCol(reference, column);
    else if (column > kWorksheetColumns)
        throw CmXmlException(kXmlError);
    column_ = static_cast<unsigned>(column - 1);
    nextColumn_ = column + 1;
}

}  // namespace dp
