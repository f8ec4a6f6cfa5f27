#include "dpxlsx/formats/numeric_variable_format.h"

#include <string>
#include <utility>

#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/model/string.h"

namespace dp {
namespace {

std::string tidyScientificText(double value, int decimals) {
    std::string text = scientificText(value, decimals);
    tidyScientific(text, decimals);
    return text;
}

}  // namespace

NumericVariableFormat::NumericVariableFormat() = default;
NumericVariableFormat::~NumericVariableFormat() = default;

IVariableFormat::FormatType NumericVariableFormat::GetType() const { return FormatType::Numeric; }

bool NumericVariableFormat::GetAuto() const { return autoFormat; }

IString* NumericVariableFormat::FormatValue(double value, bool fullPrecision) const {
    int decimals = 0;
    if (!fullPrecision) GetDecimalPlaces(&decimals, nullptr);
    if (value == 0) value = 0;  // removes the sign of a negative zero

    std::string text;
    if (GetNumericSubtype() == NumericSubtype::Scientific) {
        text = tidyScientificText(value, decimals ? decimals : roundTripDigits(value) - 1);
    } else if (decimals > 0) {
        text = fixedText(value, decimals);
    } else {
        text = GetAuto() ? generalText(value, roundTripDigits(value)) : fixedText(value, 0);
    }
    useInputDecimal(text);
    return new String(std::move(text));
}

NumericSubtype NumericVariableFormat::GetNumericSubtype() const { return numericSubtype; }

void NumericVariableFormat::GetDecimalPlaces(int* places, int* digits) const {
    if (places) *places = decimalPlaces;
    if (digits) *digits = significantDigits;
}

void NumericVariableFormat::GetValueRange(double* low, double* high) const {
    if (low) *low = rangeLow;
    if (high) *high = rangeHigh;
}

bool NumericVariableFormat::ShowFullPrecision() const { return showsFullPrecision; }

}  // namespace dp
