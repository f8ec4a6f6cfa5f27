#pragma once

#include "tools/host/workbook.h"
#include "tools/views/output.h"

namespace dp::tool {

// For each worksheet its key, title and layout, a table of its columns and its first rows as a
// host shows them.
void showTables(Workbook& workbook, const Options& options, Output& output);

}  // namespace dp::tool
