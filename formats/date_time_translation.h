#pragma once

#include <memory>
#include <string>

#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/i_variable_format.h"

// Sections of number-format codes that show dates and times.
namespace dp {

// Date, time or date-time; EXCEL_FORMAT_NONE for a section that shows none of them. What stands
// first decides: a number with a unit ("0.0 m") is no date, though "m" is a date letter.
EXCEL_FORMAT_TYPE dateTimeType(const FormatSection& section);

// The ICU pattern that shows what the section shows, in English and by the Gregorian calendar
// whatever language and calendar the code names; names of eras are left out, and elapsed hours,
// minutes and seconds are those of the day. May be empty.
std::string toIcuPattern(const FormatSection& section);

// A new format that renders serial day numbers as the section shows them, elapsed times included.
std::unique_ptr<IDateTimeVariableFormat> createDateTimeFormat(const FormatSection& section);

}  // namespace dp
