#pragma once

#include <cstdint>
#include <string>

#include "dpxlsx/model/host/export.h"

namespace dp {

// What a number format shows. The numbering keeps gaps at 1 and 6; the date-time types are 7 to 9.
enum EXCEL_FORMAT_TYPE : std::int32_t {
    EXCEL_FORMAT_NONE = 0,
    EXCEL_FORMAT_NUMBER = 2,
    EXCEL_FORMAT_CURRENCY = 3,
    EXCEL_FORMAT_PERCENT = 4,
    EXCEL_FORMAT_SCIENTIFIC = 5,
    EXCEL_FORMAT_DATE = 7,
    EXCEL_FORMAT_TIME = 8,
    EXCEL_FORMAT_DATETIME = 9,
    EXCEL_FORMAT_PARENTHESES = 10  // negative numbers in parentheses
};

// One entry of a reader's style table. A cell's style index is a position in that table.
struct DPXLSX_API xStyle {
    std::string styleId;  // the decimal number-format id, or the id attribute of an XML 2003 style
    std::string formatCode;
    std::int32_t formatType = EXCEL_FORMAT_NONE;  // an EXCEL_FORMAT_TYPE
};

// The default style of a column or of a row; the other number has no meaning. Both are 0-based.
struct DPXLSX_API xStyleRange {
    unsigned column = 0;
    unsigned row = 0;
    std::string styleId;
};

}  // namespace dp
