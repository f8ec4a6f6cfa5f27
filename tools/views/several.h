#pragma once

#include <functional>
#include <string>
#include <vector>

#include "tools/options/options.h"
#include "tools/views/output.h"

namespace dp::tool {

// Does for one workbook what the user asked for; what does not go to files of its own goes to the
// output. Returns notes to be printed after the output. Throws a Failure when the workbook cannot
// be read.
using CarryOut = std::function<std::vector<std::string>(const Options& options, Output& output)>;

// Carries out the request for each workbook in turn. Prints the failure of each that fails, goes
// on, and prints at the end how many did. What the others print is whole; in JSON a failing
// workbook has a line too. Returns the exit code of the worst: the later in 0, 2, 17, 22, 25, 13,
// 1, 3, 18, 5, 4. Throws a Failure, before anything is read, when two workbooks would write the
// same files.
int carryOutEach(const Request& request, const CarryOut& carryOut);

}  // namespace dp::tool
