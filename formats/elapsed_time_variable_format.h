#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "dpxlsx/formats/beyond_pattern.h"
#include "dpxlsx/formats/date_time_variable_format.h"

namespace dp {

// A count of whole hours, minutes or seconds.
struct ElapsedCount {
    int unit;            // in milliseconds
    std::size_t digits;  // at least so many, with leading zeros
};

// A format that shows elapsed times, which ICU has no letters for.
struct ElapsedTimeLayout {
    // Stands where a count is shown; no literal may contain it.
    static constexpr char kMark = '\x01';

    std::string text;  // an ICU pattern, or what is shown as it stands
    bool isPattern = false;
    std::vector<ElapsedCount> counts;  // one for each mark
};

// Display of serial day numbers as elapsed times: 1.5 as "36:00".
// Calls must not run at the same time, as those of all date-time formats.
class ElapsedTimeVariableFormat final : public DateTimeVariableFormat, public BeyondPattern {
  public:
    // `icuPattern` is what GetFormatString tells hosts.
    ElapsedTimeVariableFormat(const std::string& icuPattern, ElapsedTimeLayout layout);

    // A new string: the layout with the counts in it, behind a minus sign if the value is negative.
    IString* FormatValue(double value, bool fullPrecision) const override;

  private:
    ElapsedTimeLayout layout_;
    DateTimeVariableFormat rest_;  // all but the counts; one formatter, however many they are
};

}  // namespace dp
