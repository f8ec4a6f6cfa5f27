#pragma once

#include "tools/host/library.h"
#include "tools/host/workbook.h"
#include "tools/views/output.h"

namespace dp::tool {

// Writes one HTML page about the import for people to look at: layout, columns with distributions
// and missing values, first rows, and what --explain finds. It needs no other file. Opens the
// workbook, which must not be open yet: to explain it takes an import of its own before.
void writePage(const Library& library, Workbook& workbook, const Options& options, Output& output);

}  // namespace dp::tool
