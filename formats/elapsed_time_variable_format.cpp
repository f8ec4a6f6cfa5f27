#include "dpxlsx/formats/elapsed_time_variable_format.h"

#include <cmath>
#include <utility>

#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/model/string.h"

namespace dp {
namespace {

constexpr double kMillisecondsOfDay = 86400000.0;

std::string countText(double count, std::size_t digits) {
    std::string text = fixedText(count, 0);
    if (text.size() < digits) text.insert(0, digits - text.size(), '0');
    return text;
}

}  // namespace

ElapsedTimeVariableFormat::ElapsedTimeVariableFormat(const std::string& icuPattern,
                                                     const std::vector<ElapsedTimePart>& parts)
    : DateTimeVariableFormat(icuPattern) {
    for (const ElapsedTimePart& part : parts)
        parts_.push_back(
            {part.unit, part.digits,
             part.unit ? nullptr : std::make_unique<DateTimeVariableFormat>(part.pattern)});
}

IString* ElapsedTimeVariableFormat::FormatValue(double value, bool fullPrecision) const {
    const double milliseconds = std::floor(std::fabs(value) * kMillisecondsOfDay + 0.5);
    // The patterns get the rounded value, or their minutes could disagree with the counted hours.
    const double rounded = milliseconds / kMillisecondsOfDay;
    std::string text = value < 0 && milliseconds > 0 ? "-" : "";
    for (const Part& part : parts_) {
        if (part.format) {
            const std::unique_ptr<IString> shown(part.format->FormatValue(rounded, fullPrecision));
            text += shown->database_str();
        } else {
            text += countText(std::floor(milliseconds / part.unit), part.digits);
        }
    }
    return new String(std::move(text));
}

}  // namespace dp
