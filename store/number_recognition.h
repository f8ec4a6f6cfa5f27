#pragma once

#include <string>

#include "dpxlsx/model/host/export.h"

namespace dp {

// Whether `text`, without white space at its ends, is a number written with `decimal` as decimal
// symbol; "(12.5)" is -12.5, and D marks an exponent as E does. `*value` receives the number, or
// the missing value; it may be null. The process's locale decides on white space alone. Defined
// beside the setting of the missing value, in the provider.
DPXLSX_API bool IsNumber(const std::string& text, char decimal, double* value);

// The same with `missing` as the value of a text that is no number.
bool recogniseNumber(const std::string& text, char decimal, double missing, double* value);

}  // namespace dp
