#pragma once

#include <nlohmann/json_fwd.hpp>

#include "tools/host/exit_code.h"
#include "tools/host/workbook.h"
#include "tools/views/output.h"

namespace dp::tool {

// The members of the JSON document before its worksheets.
nlohmann::ordered_json bookJson(const Workbook& workbook, const Options& options);
// What a host can read of a worksheet besides its columns.
nlohmann::ordered_json worksheetJson(const LoadedWorksheet& worksheet);
// What a host can read of a column, with the first values, at most `most`.
nlohmann::ordered_json columnJson(const Column& column, size_t most);

// One JSON document, on one line, with everything that a host can read of the workbook. Values are
// in full precision, date-times are serial day numbers with their ISO and displayed texts beside
// them, missing values are null.
void writeJson(Workbook& workbook, const Options& options, Output& output);

// The line for one workbook of several that could not be read.
std::string failureJson(const std::string& book, const Failure& failure);

}  // namespace dp::tool
