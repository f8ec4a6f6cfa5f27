#pragma once

#include "tools/host/workbook.h"

namespace dp::tool {

// Writes the worksheets as CSV to options.target: a file, standard output, or a folder, which gets
// a file for each worksheet and is made when its name ends in "/"; the files of a workbook take
// their places together, after the last one is written. Lines end in a line feed, texts
// are UTF-8, missing values are empty fields, the first line has the names ("C" and the position
// for a column without one).
void writeCsv(Workbook& workbook, const Options& options);

// Whether a target is a folder: an existing one, or a name that ends in "/".
bool meansFolder(const std::string& target);

// The folder below `target` for the worksheets of one workbook of several: its name without .xlsx.
std::string folderOf(const std::string& book, const std::string& target);

}  // namespace dp::tool
