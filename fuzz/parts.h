#pragma once

#include <map>
#include <string>

namespace fuzz {

// The parts of a small valid workbook by their names: two worksheets, shared strings, styles.
const std::map<std::string, std::string>& soundParts();

}  // namespace fuzz
