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

// Reads all cells and notes what it finds.
void inspectWorksheet(Package& package, const WorksheetPart& worksheet,
                      const NumberFormats& formats, Findings& findings);

// Notes prefixes by the first element alone, and the first ISO date. `unpacked` is the same part as
// a file.
void inspectWorksheetQuickly(Package& package, const WorksheetPart& worksheet,
                             const std::string& unpacked, Findings& findings);

}  // namespace dp::tool
