#pragma once

#include <string>

#include "tools/findings.h"

namespace dp::tool {

// Looks into the file by itself, without the import library. Everything is read as a stream.
// Throws a Failure when the file cannot be read, and Interrupted.
Findings inspect(const std::string& book);

// Looks only for what damages an import most: prefixes, a table of texts without its count, ISO
// dates, the date system of 1904, and files that are no workbook. Worksheets are read in `folder`,
// where the library has unpacked the open package, which spares unpacking them again; without a
// folder they are not looked at.
Findings inspectQuickly(const std::string& book, const std::string& folder);

}  // namespace dp::tool
