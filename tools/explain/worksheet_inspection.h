#pragma once

#include <string>
#include <vector>

#include "tools/explain/findings.h"
#include "tools/explain/number_formats.h"
#include "tools/host/imported.h"
#include "tools/package/package.h"

namespace dp::tool {

struct WorksheetPart {
    std::string name;  // of the worksheet
    std::string part;
    bool hidden;
    size_t place;  // in the book, 0-based
};

// The shared texts: their number, and those written in a way because of which something is lost.
struct SharedTexts {
    size_t count = 0;
    std::vector<bool> phonetic;
    std::vector<bool> cdata;
};

// What the cells of a worksheet refer to, and what an import made of the worksheet.
struct Tables {
    const NumberFormats* formats;  // null to leave formats out
    const SharedTexts& texts;
    const ImportedSheet* imported;  // null when the worksheet was not imported
};

// Reads all cells that are imported and notes what it finds.
void inspectWorksheet(Package& package, const WorksheetPart& worksheet, const Tables& tables,
                      Findings& findings);

// Notes only what the first element shows of prefixes, the first ISO date, and, when the import has
// no shared texts, the first cell that needs one. `unpacked` is the same part as a file.
void inspectWorksheetQuickly(Package& package, const WorksheetPart& worksheet,
                             const std::string& unpacked, bool hasTexts, Findings& findings);

}  // namespace dp::tool
