#pragma once

#include <string>
#include <vector>

namespace dp::standard {

struct Sheet {
    std::string name;
    std::string relationshipId;
};

// What a workbook part says of the cells of its worksheets.
struct WorkbookPart {
    std::vector<Sheet> sheets;  // in order
    bool date1904 = false;      // day numbers count from 1904-01-01
};

// Throws CmXmlException when the part cannot be read, is no workbook, or has no list of sheets.
WorkbookPart readWorkbookPart(const std::string& path);

}  // namespace dp::standard
