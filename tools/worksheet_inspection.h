#pragma once

#include <string>

#include "tools/findings.h"
#include "tools/number_formats.h"
#include "tools/package.h"

namespace dp::tool {

struct WorksheetPart {
    std::string name;  // of the worksheet
    std::string part;
    bool hidden;
};

// What cells refer to.
struct Tables {
    const NumberFormats* formats;  // null to leave formats out
    size_t texts;                  // how many shared texts there are
};

// Reads all cells and notes what it finds.
void inspectWorksheet(Package& package, const WorksheetPart& worksheet, const Tables& tables,
                      Findings& findings);

// Notes prefixes by the first element alone, the first ISO date, and, when the package has no
// shared texts, the first cell that wants one. `unpacked` is the same part as a file.
void inspectWorksheetQuickly(Package& package, const WorksheetPart& worksheet,
                             const std::string& unpacked, bool hasTexts, Findings& findings);

}  // namespace dp::tool
