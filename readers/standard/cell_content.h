#pragma once

#include <optional>
#include <string>

#include "dpxlsx/readers/standard/number_formats.h"
#include "dpxlsx/readers/xlsx/shared_string_table.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp::standard {

// A cell as a worksheet part writes it.
struct CellMarkup {
    std::string type;                       // its `t`, "n" when it has none
    int style = 0;                          // its `s`
    std::optional<std::string> value;       // the text of its `v`
    std::optional<std::string> inlineText;  // of its `is`, decoded
};

// What cells of a workbook refer to.
struct CellReferences {
    SharedStringTable strings;  // decoded
    NumberFormats formats;
    bool date1904 = false;
};

// What the cell holds; nothing for one without a value and for texts of spaces alone. An error is
// CELL_EMPTY, and a value that is not what its type says kUnreadableContent: missing values that
// count as rows. May add formats to `references`.
std::optional<ExternalDataRecordCell> contentOf(const CellMarkup& markup,
                                                CellReferences& references);

}  // namespace dp::standard
