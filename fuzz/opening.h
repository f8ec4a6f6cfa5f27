#pragma once

#include <string>

namespace fuzz {

// Lists and opens the workbook at `path` through the entry points, takes everything out of it,
// closes and takes it again. Whatever the bytes are, that ends in a result code or in the readers'
// exception; returns the code of either.
long openAsHost(const std::string& path);

}  // namespace fuzz
