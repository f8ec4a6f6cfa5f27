#include "readers/cell_reference.h"

#include <algorithm>

#include "readers/xml_reader.h"

namespace dp {

namespace {

// The size of a worksheet. Cells beyond it exist in no workbook, and would make the work on rows
// and columns as large as their numbers.
constexpr int kRows = 1'048'576;
constexpr int kColumns = 16'384;

bool isDigit(char c) { return c >= '0' && c <= '9'; }

}  // namespace

void mDetermineCol(std::string_view reference, int& column) {
    if (reference.size() < 2) throw CmXmlException(kXmlError);
    const auto digit = std::find_if(reference.begin() + 1, reference.end(), isDigit);
    if (digit == reference.end()) throw CmXmlException(kXmlError);
    long value = 0;
    for (auto letter = reference.begin(); letter != digit; ++letter) {
        value = value * 26 + (static_cast<unsigned char>(*letter) - 64);
        // From here no further letter leads back to a column.
        if (value > kColumns * 26L || value < -kColumns) throw CmXmlException(kXmlError);
    }
    if (value < 1 || value > kColumns) throw CmXmlException(kXmlError);
    column = static_cast<int>(value);
}

void CellPlace::beginRow(const int* number) {
    const int next = number ? *number : row_ + 2;
    if (next < 1 || next > kRows) throw CmXmlException(kXmlError);
    row_ = next - 1;
    column_ = -1;
}

void CellPlace::beginCell(const char* reference) {
    int next = column_ + 2;
    if (reference)
        mDetermineCol(reference, next);
    else if (next > kColumns)
        throw CmXmlException(kXmlError);
    column_ = next - 1;
    if (row_ < 0) row_ = 0;
}

}  // namespace dp
