#pragma once

#include <string>

namespace dp {

// The ICU date pattern for a cleaned Excel date-time code (exact, case-sensitive match); null when
// there is none. The string lives as long as the library is loaded.
const std::string* icuPatternOf(const std::string& excelCode);

}  // namespace dp
