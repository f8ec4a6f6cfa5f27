#pragma once

#include <string>

#include "dpxlsx/readers/xlsx/shared_string_table.h"
#include "dpxlsx/readers/xml/plain_xml.h"

namespace dp {

// Reads a plain shared-string part into an empty table, several times as fast as
// readAnySharedStrings does. False, and the table is of no use, when the part is not plain.
bool readPlainSharedStrings(const std::string& path, SharedStringTable& table,
                            ReadingWindow window = {});

}  // namespace dp
