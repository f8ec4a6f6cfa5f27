#pragma once

#include <string>

namespace dp {

// Whether the last element of the path ends in ".xlsx", in any letter case.
bool hasXlsxExtension(const std::string& path);

}  // namespace dp
