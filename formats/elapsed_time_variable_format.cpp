#include "dpxlsx/formats/elapsed_time_variable_format.h"

#include <cmath>
#include <memory>
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
                                                     ElapsedTimeLayout layout)
    : DateTimeVariableFormat(icuPattern), layout_(std::move(layout)), rest_(layout_.text) {}

IString* ElapsedTimeVariableFormat::FormatValue(double value, bool fullPrecision) const {
    const double milliseconds = std::floor(std::fabs(value) * kMillisecondsOfDay + 0.5);
    // The pattern gets the rounded value, or its minutes could disagree with the counted hours.
    const double rounded = milliseconds / kMillisecondsOfDay;
    std::string rest = layout_.text;
    if (layout_.isPattern)
        rest = std::unique_ptr<IString>(rest_.FormatValue(rounded, fullPrecision))->database_str();

    std::string text = value < 0 && milliseconds > 0 ? "-" : "";
    auto count = layout_.counts.begin();
    for (const char c : rest) {
        if (c != ElapsedTimeLayout::kMark) {
            text += c;
        } else if (count != layout_.counts.end()) {
            text += countText(std::floor(milliseconds / count->unit), count->digits);
            ++count;
        }
    }
    return new String(std::move(text));
}

}  // namespace dp
