#pragma once

#include "tools/host/workbook.h"
#include "tools/views/output.h"

namespace dp::tool {

// One JSON document with everything that a host can read of the workbook: a line per column.
// Values are in full precision, date-times are serial day numbers with their ISO and displayed
// texts beside them, missing values are null.
void writeJson(Workbook& workbook, const Options& options, Output& output);

}  // namespace dp::tool
