#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"

// What the readers do with their style tables: classify the number-format codes, replace names and
// locale-dependent codes by concrete ones, and build the format objects of columns.
namespace dp {

// True for the date, time and date-time types.
bool isDateTimeType(EXCEL_FORMAT_TYPE type) noexcept;

// Sets the style's type by its number-format code. A code that shows dates or times gives one of
// the three date-time types and is replaced by what parseDateTimeFormat() makes of it. Any other
// code, percentages and currencies included, stays as it is and gives EXCEL_FORMAT_NONE.
void setFormatType(xStyle& style);

// The codes for those descriptive format names that do not have one fixed code.
struct NamedFormats {
    std::string_view shortDate;
    std::string_view percent;
    std::string_view currency;
    std::string_view scientific;
    std::string_view fixed;
};

// Replaces descriptive names ("Short Date", "Percent" ...) in the table by code and type.
void replaceDescriptiveNames(std::vector<xStyle>& styles, const NamedFormats& formats);

// The parts of a default date-time code, to be combined.
enum DateTimePart : unsigned { DATE_PART = 1, TIME_PART = 2, SECONDS_PART = 4, AMPM_PART = 8 };

// Supplies the masks of a locale. The time mask is requested for every code, the others only for
// codes that need them.
struct DateTimeMasks {
    using Source = std::function<const std::string&()>;

    Source time;       // hours and minutes, "hh:mm"
    Source separator;  // before the seconds, ":"
    Source ampm;       // "AM/PM"
};

// Composes the default code for the parts `flags` into `code`; without date and time part `code`
// stays as it is.
void composeDateTimeCode(std::string& code, unsigned flags, const DateTimeMasks& masks);

// Gives the first style of each locale-dependent built-in id ("14", "18" to "22") its default
// code; types are left alone.
void updateFormatsForLocale(std::vector<xStyle>& styles, const DateTimeMasks& masks);

// Predicate: true for a style with the given id.
class DPXLSX_API DateTimeFormatEqualCode {
  public:
    explicit DateTimeFormatEqualCode(std::string styleId);

    bool operator()(const xStyle& style) const;

  private:
    std::string styleId_;
};

// A new format for the style at `styleIndex`, owned by the caller. `isDateTime` says whether the
// reader classified the style as date-time: then the backslashes are removed from its code in the
// table, and the format uses the code's ICU pattern, or ICU's medium date style when the code has
// none. Other codes give a decimal, percentage or scientific format. Everything else, including
// currency codes and an index outside the table, gives the automatic numeric format.
IVariableFormat* createStyleFormat(std::vector<xStyle>& styles, int styleIndex, bool isDateTime);

}  // namespace dp
