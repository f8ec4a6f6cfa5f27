#pragma once

#include <memory>

#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// A new format that shows each value by the section that fits it. What else it tells (type,
// decimals, pattern) is that of the first section.
//
// The first section shows the number alone, as the numeric formats do. The others also show their
// texts, which say what is special about the number; the first section's texts are units and left
// out there too. A section of nothing but text shows the text in place of the number. A minus sign
// is left out only where a section for negative numbers alone shows one of its own, or parentheses;
// in a section for others such texts are shown with zero alone. Numbers that a section would hide,
// or show as another number or as a date although the first section shows numbers, are shown with
// all digits.
std::unique_ptr<IVariableFormat> createVariableFormat(const NumberFormatCode& code);

}  // namespace dp
