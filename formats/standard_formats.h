#pragma once

#include <string_view>

#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/formats/style.h"

// Number formats as the standard defines them and spreadsheet programs show them in US English.
namespace dp {

// The code of a built-in number format; "General" for ids that have none. The ids whose codes
// depend on the language have the codes that spreadsheet programs use in US English.
std::string_view builtInFormatCode(int id);

// Date, time or date-time by what the first section shows; EXCEL_FORMAT_NONE for numbers and texts.
EXCEL_FORMAT_TYPE formatType(const NumberFormatCode& code);

}  // namespace dp
