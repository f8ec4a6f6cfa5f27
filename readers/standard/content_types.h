#pragma once

#include <string>

#include "dpxlsx/readers/standard/package_parts.h"

namespace dp::standard {

// Whether the package's list of content types lets this part be a workbook in XML. The types of
// workbooks, templates and add-ins, with macros or without, say so; those of XML in general, and a
// list that leaves the part out, is missing or is damaged, leave it to the part itself.
bool mayBeWorkbook(const PackageParts& parts, const std::string& part);

}  // namespace dp::standard
