#include "dpxlsx/formats/fraction_variable_format.h"

#include <cmath>
#include <string>

#include "dpxlsx/formats/number_text.h"
#include "dpxlsx/model/string.h"

namespace dp {
namespace {

struct FractionParts {
    double whole;
    double numerator;
};

// Splits the magnitude of `value`; unless `mixed`, the numerator takes in the whole part.
FractionParts splitFraction(double value, int denominator, bool mixed) {
    FractionParts parts;
    parts.numerator = std::nearbyint(std::modf(std::fabs(value), &parts.whole) * denominator);
    if (parts.numerator == denominator) return {parts.whole + 1, 0};
    if (parts.numerator > 0 && !mixed) return {0, parts.numerator + denominator * parts.whole};
    return parts;
}

std::string fractionText(const FractionVariableFormat& format, double value) {
    const auto [whole, numerator] = splitFraction(value, format.denominator, format.mixedFraction);
    const bool negative = value < 0;
    std::string text;
    if ((format.mixedFraction && whole > 0) || numerator == 0)
        text = (negative ? "-" : "") + fixedText(whole, format.maximumDigits);
    if (numerator > 0) {
        if (!text.empty())
            text += ' ';
        else if (negative)
            text += "- ";
        text += fixedText(numerator, format.significantDigits) + '/' +
                fixedText(format.denominator, format.decimalPlaces);
    }
    return text;
}

}  // namespace

FractionVariableFormat::FractionVariableFormat() = default;
FractionVariableFormat::~FractionVariableFormat() = default;

IVariableFormat::FormatType FractionVariableFormat::GetType() const { return FormatType::Numeric; }

bool FractionVariableFormat::GetAuto() const { return autoFormat; }

IString* FractionVariableFormat::FormatValue(double value, bool fullPrecision) const {
    if (fullPrecision || showsFullPrecision)
        return new String(generalText(value, significantDigits));
    return new String(fixedDenominator ? fractionText(*this, value) : std::string());
}

NumericSubtype FractionVariableFormat::GetNumericSubtype() const {
    return NumericSubtype::Fraction;
}

void FractionVariableFormat::GetDecimalPlaces(int* places, int* digits) const {
    if (places) *places = decimalPlaces;
    if (digits) *digits = significantDigits;
}

void FractionVariableFormat::GetValueRange(double* low, double* high) const {
    if (low) *low = rangeLow;
    if (high) *high = rangeHigh;
}

bool FractionVariableFormat::ShowFullPrecision() const { return showsFullPrecision; }

int FractionVariableFormat::GetDenominator() const { return denominator; }

int FractionVariableFormat::GetMaximumDigits() const { return maximumDigits; }

bool FractionVariableFormat::GetMixedFraction() const { return mixedFraction; }

bool FractionVariableFormat::GetFixedDenominator() const { return fixedDenominator; }

}  // namespace dp
