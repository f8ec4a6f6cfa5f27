#include "dpxlsx/formats/percentage_variable_format.h"

#include <string>
#include <utility>

#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/model/string.h"

namespace dp {

PercentageVariableFormat::PercentageVariableFormat() = default;
PercentageVariableFormat::~PercentageVariableFormat() = default;

IVariableFormat::FormatType PercentageVariableFormat::GetType() const {
    return FormatType::Numeric;
}

bool PercentageVariableFormat::GetAuto() const { return autoFormat; }

IString* PercentageVariableFormat::FormatValue(double value, bool fullPrecision) const {
    const double percentage = value * 100;
    std::string text = fullPrecision || ShowFullPrecision()
                           ? generalText(percentage, significantDigits)
                           : fixedText(percentage, percentDecimalPlaces);
    text += '%';
    useInputDecimal(text);
    return new String(std::move(text));
}

NumericSubtype PercentageVariableFormat::GetNumericSubtype() const { return numericSubtype; }

void PercentageVariableFormat::GetDecimalPlaces(int* places, int* digits) const {
    if (places) *places = decimalPlaces;
    if (digits) *digits = significantDigits;
}

void PercentageVariableFormat::GetValueRange(double* low, double* high) const {
    if (low) *low = rangeLow;
    if (high) *high = rangeHigh;
}

bool PercentageVariableFormat::ShowFullPrecision() const { return showsFullPrecision; }

int PercentageVariableFormat::GetDecimalPlaces() const { return percentDecimalPlaces; }

}  // namespace dp
