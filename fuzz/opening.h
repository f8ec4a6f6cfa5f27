#pragma once

#include <string>

namespace fuzz {

// Lists and opens the workbook at `path` through the entry points, loads everything in it, closes
// it and loads everything again; by the standard first, and then by the default rules. Whatever
// the bytes are, this must end with a result code or the readers' exception; returns the code of
// the latter reading.
long openAsHost(const std::string& path);

}  // namespace fuzz
