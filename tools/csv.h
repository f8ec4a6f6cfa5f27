#pragma once

#include "tools/workbook.h"

namespace dp::tool {

// Writes the worksheets as CSV: to the file or to standard output when there is one, else a file
// per worksheet into the folder that options.target names, made when it ends in "/".
// Lines end in a line feed, texts are UTF-8, missing values are empty fields, the first line has
// the names ("C" and the position for a column without one).
void writeCsv(Workbook& workbook, const Options& options);

}  // namespace dp::tool
