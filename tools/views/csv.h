#pragma once

#include "tools/host/workbook.h"

namespace dp::tool {

// Writes the worksheets as CSV to options.target: a file, standard output, or a folder, which gets
// a file for each worksheet and is made when its name ends in "/". Lines end in a line feed, texts
// are UTF-8, missing values are empty fields, the first line has the names ("C" and the position
// for a column without one).
void writeCsv(Workbook& workbook, const Options& options);

}  // namespace dp::tool
