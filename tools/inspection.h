#pragma once

#include <set>
#include <string>

#include "tools/findings.h"
#include "tools/imported.h"

namespace dp::tool {

// Looks into the file by itself, without the import library. Everything is read as a stream.
// `imported` is what an import made of it, empty when there was none. Throws a Failure when the
// file cannot be read, and Interrupted.
Findings inspect(const std::string& book, const Imported& imported);

// Looks only for what damages an import most: prefixes, a table of texts without its count, ISO
// dates, the date system of 1904, and files that are no workbook. Worksheets are read in `folder`,
// where the library has unpacked the open package, which spares unpacking them again; without a
// folder they are not looked at, nor are those that are left out.
Findings inspectQuickly(const std::string& book, const std::string& folder,
                        const std::set<std::string>& leftOut);

}  // namespace dp::tool
