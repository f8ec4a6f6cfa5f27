#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/formats/date_time_variable_format.h"

namespace dp {

// A part of a format that shows elapsed times: either a count of whole hours, minutes or seconds or
// an ICU pattern.
struct ElapsedTimePart {
    int unit = 0;            // of the count, in milliseconds; 0 for a pattern
    std::size_t digits = 0;  // the count has at least so many, with leading zeros
    std::string pattern;     // not empty if it is one
};

// Display of serial day numbers as elapsed times, which ICU has no letters for: 1.5 as "36:00".
// Calls must not run at the same time, as those of all date-time formats.
class ElapsedTimeVariableFormat : public DateTimeVariableFormat {
  public:
    // `icuPattern` is what GetFormatString tells hosts.
    ElapsedTimeVariableFormat(const std::string& icuPattern,
                              const std::vector<ElapsedTimePart>& parts);

    // A new string: the parts one after another, behind a minus sign if the value is negative.
    IString* FormatValue(double value, bool fullPrecision) const override;

  private:
    struct Part {
        int unit;
        std::size_t digits;
        std::unique_ptr<DateTimeVariableFormat> format;  // null for a count
    };

    std::vector<Part> parts_;
};

}  // namespace dp
