#pragma once

#include <string>

namespace dp {

// The ICU date pattern of a cleaned Excel date-time code, compared whole and by case; null when
// there is none. The text lives as long as the library is loaded.
const std::string* icuPatternOf(const std::string& excelCode);

}  // namespace dp
