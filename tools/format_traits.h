#pragma once

#include <map>

#include "tools/style_probe.h"
#include "tools/trait.h"

// Traits of cells by their number formats: by the rules of spreadsheet programs, by the library's
// answers about the cell styles, and by the kinds that the import gave to their columns.
namespace dp::tool {

using StyleAnswers = std::map<int, StyleAnswer>;  // by index of the cell style

Found takenForDates(const Findings& findings, const StyleAnswers& answers);
Found notTakenForDates(const Findings& findings, const StyleAnswers& answers);
Found uncountedFormats(const Findings& findings, const StyleAnswers& answers);
Found mixedDates(const Findings& findings, const StyleAnswers& answers);
Found defaultDateStyle(const Findings& findings, const StyleAnswers& answers);

}  // namespace dp::tool
