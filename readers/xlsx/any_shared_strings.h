#pragma once

#include <string>

#include "dpxlsx/readers/xlsx/shared_string_table.h"

namespace dp {

// Reads any shared-string part into an empty table, by libxml2's text reader. Throws CmXmlException
// when it cannot be read.
void readAnySharedStrings(const std::string& path, SharedStringTable& table);

}  // namespace dp
