#pragma once

#include <memory>

#include "dpxlsx/formats/number_format_code.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp {

// How a section shows numbers, as far as the numeric formats can do so too. They have no grouping,
// no leading zeros and no texts around the number.
struct NumberDisplay {
    enum class Kind { Automatic, Fixed, Percentage, Scientific };

    Kind kind = Kind::Automatic;  // all digits of the value
    int decimals = 0;
};

// Automatic for what would otherwise show another number: fractions, values divided by thousands
// ("0.0,") and percentages of percentages, and for sections without digits.
NumberDisplay numberDisplay(const FormatSection& section);

// A new format for that display.
std::unique_ptr<INumericVariableFormat> createNumberFormat(NumberDisplay display);

}  // namespace dp
