#pragma once

#include <set>
#include <string>

#include "tools/explain/findings.h"
#include "tools/host/imported.h"

namespace dp::tool {

// Inspects the file without the import library, reading its parts as streams. `imported` is what an
// import made of it; empty without an import. Throws a Failure when the file cannot be read, and
// Interrupted after an interrupt.
Findings inspect(const std::string& book, const Imported& imported);

// Looks only for the traits that do most harm to an import: prefixes, a table of texts without its
// count, ISO dates, the 1904 date system, and files that are not workbooks. Worksheets are read
// from `folder`, into which the library has unpacked the open package, to save unpacking them
// again. Without a folder no worksheet is inspected; those in `leftOut` never are.
Findings inspectQuickly(const std::string& book, const std::string& folder,
                        const std::set<std::string>& leftOut);

}  // namespace dp::tool
