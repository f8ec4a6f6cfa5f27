#pragma once

#include <string>

#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/export.h"

// Recognisers of Excel number-format codes. They accept the plain shapes that Excel's built-in
// formats use and reject everything else; none of them fails on any text. Those of date-times are
// in date_time_code.cpp, all others in format_codes.cpp.
namespace dp {

class NumericVariableFormat;
class PercentageVariableFormat;

// The words of number-format codes: "General", "@", "#,##0", "##", "E+0", "E+00", "[$", ";" and
// "%".
extern DPXLSX_API const std::string GENERAL_FORMAT;
extern DPXLSX_API const std::string TEXT_FORMAT;
extern DPXLSX_API const std::string SIGNIFICANT_DIGITS_MASK;
extern DPXLSX_API const std::string SCIENTIFIC_SIGNIFICANT_DIGITS_MASK;
extern DPXLSX_API const std::string SCIENTIFIC_SHORT_FORM;
extern DPXLSX_API const std::string SCIENTIFIC_LONG_FORM;
extern DPXLSX_API const std::string LANG_ID_MASK;
extern DPXLSX_API const std::string FORMAT_TOKEN_SEPARATOR;
extern DPXLSX_API const std::string PERCENT_SYMBOL;

// A fixed-decimal code: "0", "0.", "0.00", each with or without a leading "#,##"; also the empty
// code.
DPXLSX_API bool parseDecimalFormat(const std::string& code);

// A fixed-decimal code followed by "%".
DPXLSX_API bool parsePercentageFormat(const std::string& code);

// A fixed-decimal code that is not empty, followed by "E+0" or "E+00", with or without a leading
// "##".
DPXLSX_API bool parseScientficFormat(const std::string& code);

// A code whose first section groups thousands and carries a currency tag or a quoted text.
DPXLSX_API bool parseCurrencyFormat(const std::string& code);

// Whether the code shows dates or times. If so, `cleaned` is the first section without backslashes,
// locale tag and what precedes the tag, and `type` is one of the three date-time types; after a
// bracketed part such as "[h]", the point after the seconds becomes the input decimal symbol and up
// to three zeros behind it become "s". If not, `cleaned` is the whole code without backslashes, tag
// and what precedes the tag, and `type` is unchanged. `cleaned` may be `code` itself.
DPXLSX_API bool parseDateTimeFormat(const std::string& code, std::string& cleaned,
                                    EXCEL_FORMAT_TYPE& type);

// New formats for codes that the recogniser of the same kind accepted; the caller owns them. `code`
// is not changed.
DPXLSX_API NumericVariableFormat* createVextralDecimalFormat(std::string& code);
DPXLSX_API PercentageVariableFormat* createVextralPercentageFormat(std::string& code);
DPXLSX_API NumericVariableFormat* createVextralScientificFormat(std::string& code);

// The short-date code "m/d/yy".
DPXLSX_API std::string GetShortDateMask();

// The last `count` characters of `text`. Throws std::out_of_range when it is shorter.
DPXLSX_API std::string getRightSubString(const std::string& text, unsigned count);

// Takes every backslash out of `code`.
void removeBackslashes(std::string& code);

}  // namespace dp
