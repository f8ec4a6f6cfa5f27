#pragma once

#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

// The size of a worksheet. Readers treat values beyond it as an error: no program writes them, and
// work that is proportional to row and column numbers would be unbounded.
inline constexpr int kWorksheetRows = 1'048'576;
inline constexpr int kWorksheetColumns = 16'384;

// Throws CmXmlException for a position (0-based) that no worksheet has.
inline void requireInWorksheet(unsigned row, unsigned column) {
    if (row >= kWorksheetRows || column >= kWorksheetColumns) throw CmXmlException(kXmlError);
}

}  // namespace dp
