#pragma once

#include <map>
#include <vector>

#include "tools/explain/style_probe.h"
#include "tools/explain/trait.h"

// Traits that result from number formats. They follow from how spreadsheet programs and the library
// each treat the cell styles, and from the kinds that the import gave the columns.
namespace dp::tool {

using StyleAnswers = std::map<int, StyleAnswer>;  // by index of the cell style

// Numbers that arrive as dates, and dates that arrive as numbers, each cause on its own.
std::vector<Trait> misjudgedFormats(const Findings& findings, const StyleAnswers& answers);
Found mixedDates(const Findings& findings, const StyleAnswers& answers);
Found defaultDateStyle(const Findings& findings, const StyleAnswers& answers);

}  // namespace dp::tool
