#pragma once

#include <string>
#include <vector>

#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/relationships.h"
#include "dpxlsx/readers/xlsx/repeated_parts.h"
#include "dpxlsx/readers/xlsx/shared_string_table.h"
#include "dpxlsx/readers/xlsx/text_budget.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp {

// The kind of a number cell according to its style.
struct NumberKind {
    ExternalCellType type = CELL_NUMBER;
    int formatIndex = -1;
};

// What an ExcelXLSXReader knows of its package beyond the fields that hosts see.
struct ExcelXLSXReader::OpenedPackage {
    std::string dir;
    SharedStringTable sharedStrings;  // decoded; blank texts, which cells do not deliver, are empty
    RelationshipIndex relationships;
    std::vector<NumberKind> numberKinds;  // by position in cellXfNumFmtIds
    TextBudget textBudget;
    RepeatedParts repeatedParts;
};

}  // namespace dp
