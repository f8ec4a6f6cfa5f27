#pragma once

#include <memory>
#include <string_view>

#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/i_variable_format.h"

// Number formats as the standard defines them and spreadsheet programs show them in US English.
namespace dp {

// The code of a built-in number format; "General" for ids that have none. The ids whose codes
// depend on the language have the codes that spreadsheet programs use in US English.
std::string_view builtInFormatCode(int id);

// Date, time or date-time by what the first section shows; EXCEL_FORMAT_NONE for numbers and texts.
EXCEL_FORMAT_TYPE formatType(const NumberFormatCode& code);

// A new format that shows values as the first section does.
std::unique_ptr<IVariableFormat> createVariableFormat(const NumberFormatCode& code);

}  // namespace dp
