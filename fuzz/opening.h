#pragma once

#include <string>

namespace fuzz {

// Lists and opens the workbook at `path` through the entry points, loads everything in it, closes
// it and loads everything again; by the standard first, and then by the default rules. Whatever
// the bytes are, this must end with a result code or the readers' exception; returns the code of
// the latter reading. The work is ended at the report `end` of its progress, from 1 on; 0 for none.
long openAsHost(const std::string& path, unsigned end = 0);

}  // namespace fuzz
