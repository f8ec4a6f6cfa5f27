#pragma once

#include <optional>
#include <string_view>

#include "dpxlsx/formats/style.h"

// The values of cells and attributes, as they are written. White space around them does not count.
namespace dp::standard {

// A finite number, an xsd:double: "1.5", "-2E3". Nothing for any other text, NaN and INF included.
std::optional<double> parseNumber(std::string_view text);

// "1", "true" and "on", "0", "false" and "off" in any letter case.
std::optional<bool> parseBoolean(std::string_view text);

// An integer without a sign; the largest int stands for larger ones.
std::optional<int> parseIndex(std::string_view text);

// A date, time or date-time of ISO 8601.
struct IsoDateTime {
    double dayNumber;        // serial, of the 1900 system
    EXCEL_FORMAT_TYPE type;  // what the text gives: EXCEL_FORMAT_DATE, _TIME or _DATETIME
    bool isDuration = false;
};

// "2024-01-05", "06:30" or both with "T" between them; a time may begin with the "T" and have
// seconds with a fraction and a time zone. Local times stay what they are: the zone shifts nothing.
// Durations, "PT6H30M", are times. Nothing for any other text and for days before 1899-12-30, which
// have no day numbers.
std::optional<IsoDateTime> parseIsoDateTime(std::string_view text);

}  // namespace dp::standard
